# Functions for the scripts that start the program with the simulated venue.

# MakeData DEFAULTS FOLDER: creates below FOLDER (for XDG_DATA_HOME) the data that the program's first run would create from
# the files in DEFAULTS.
MakeData() {
  local data=$2/Orvalin/Tessarine
  mkdir -p "$data"
  cp "$1/scenarios_default.mdb" "$data/scenarios.mdb"
  cp "$1/members_default.mdb" "$data/members.mdb"
  cp "$1/score_card_default.doc" "$data/score_card.doc"
  cp "$1/tessarine.ini" "$data/tessarine.ini"
}

# AddDemoData PROGRAM FOLDER PLAYERS SEED PORT OWNERS: adds to this data, by PROGRAM (tessarine-demo-data), the demo's mission
# and members, and the two instruments of the simulated venue, whose lines are in FOLDER, as ports 1 and 2; PORT is the one in
# use. The file OWNERS then tells who has which button.
AddDemoData() {
  local data=$2/Orvalin/Tessarine
  printf '[comm]\ncommport=%s\n[ports]\ncom1=%s\ncom2=%s\n' "$5" "$2/base-unit" "$2/radio-modem" > "$data/tessarine.ini"
  "$1" "$3" "$4" "$data" "$6"
}

# SwitchOnAudience PROGRAM FOLDER: has PROGRAM (tessarine) begin on this data with the audience board, as if on a large screen, and
# with the results page, on this computer alone.
SwitchOnAudience() {
  local data=$2/Orvalin/Tessarine release
  release=$("$1" --version)
  printf '[audience]\nvenue=Harbour Lights Arena\ndiagonal=65\ndistance=8\n' >> "$data/tessarine.ini"
  printf '[results]\non=1\naddress=127.0.0.1\n' >> "$data/tessarine.ini"
  printf '[audience]\non=1\n[program]\nrelease=%s\n' "${release#* }" > "$data/state.ini"
}

# StartVenue PROGRAM FOLDER PLAYERS SEED [OPTION...]: starts the simulated venue by PROGRAM (tessarine-venue), with its lines in
# FOLDER, and waits until it serves. Sets "venue" to its process id.
StartVenue() {
  local folder=$2
  "$1" --players "$3" --seed "$4" --link "$folder/base-unit" --radio --radio-link "$folder/radio-modem" "${@:5}" &
  venue=$!
  until [ -e "$folder/base-unit" ] && [ -e "$folder/radio-modem" ]; do
    kill -0 "$venue" 2>/dev/null || return 1
    sleep 0.05
  done
}
