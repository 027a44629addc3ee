#!/usr/bin/env bash
# Each kind of wrong include is told by tools/floors, in a small house made for it.
set -euo pipefail
source=$(cd "$(dirname "$0")/../.." && pwd)
house=$(mktemp -d)
trap 'rm -rf "$house"' EXIT
faults=0

# Put FILE LINE...: writes a file of the house.
Put() {
  local file=$house/$1
  shift
  mkdir -p "${file%/*}"
  printf '%s\n' "$@" > "$file"
}

NewHouse() {
  rm -rf "${house:?}"/*
  mkdir "$house/tools"
  cp "$source"/tools/{floors,floors.awk,files.sh} "$house/tools"
  Put src/platform/Clock.h
  Put src/platform/sqlite/Engine.h '#include "platform/Clock.h"'
  Put src/core/game/Game.h '#include "platform/Clock.h"' '#include <string>'
  Put src/members/Members.h '#include <QWidget>' '#include "core/game/Game.h"'
  Put src/members/Members.cpp '#include "members/Members.h"' '#include "ui_Members.h"'
  Put src/members/Members.ui
  Put src/members/Rows.h
  Put src/devices/radio/Link.h
  Put src/app/main.cpp '#include "members/Members.h"' '#include "members/Rows.h"' '#include "devices/radio/Link.h"' \
    '#include "platform/sqlite/Engine.h"'
  Put sim/line/Wire.h
  Put sim/radio/Gun.cpp '#include "sim/line/Wire.h"'
  Put tests/core/game/GameTest.cpp '#include "core/game/Game.h"' '#include "sim/line/Wire.h"'
}

# Tells NAME EXPECTED: the floors of the house fail with a line that holds EXPECTED.
Tells() {
  local output
  if output=$("$house/tools/floors"); then
    echo "$1: not noticed"
    faults=1
  elif ! grep -qF -- "$2" <<< "$output"; then
    printf '%s: told as\n%s\n' "$1" "$output"
    faults=1
  fi
}

NewHouse
"$house/tools/floors" || { echo "A good house is refused"; faults=1; }
graph=$("$house/tools/floors" --graph)
[ "$(grep -c . <<< "$graph")" = 9 ] && grep -qxF "src/app -> src/members (2)" <<< "$graph" || { echo "The graph: $graph"; faults=1; }

NewHouse; Put src/core/game/Bad.cpp '#include "members/Rows.h"'
Tells "An include upwards" "src/core/game/Bad.cpp: includes upwards: src/members/Rows.h"
NewHouse; Put src/core/data/Ini.h '  #  include "core/game/Game.h"'; Put src/core/game/Bad.cpp '#include "core/data/Ini.h"'
Tells "A circle of two folders" "circle: src/core/"
NewHouse; Put sim/line/Wire.h '#include "sim/venue/Venue.h"'; Put sim/venue/Venue.h '#include "sim/radio/Modem.h"'
Put sim/radio/Modem.h '#include "sim/line/Wire.h"'
Tells "A circle of three folders" "circle: "
NewHouse; Put src/devices/buttons/Bad.cpp '#include "devices/radio/Link.h"'
Tells "One room of devices in another" "rooms of devices do not know each other"
NewHouse; Put src/missions/Bad.cpp '#include "members/Members.h"'
Tells "Another subject's window" "includes the window of another subject"
NewHouse; Put src/core/game/Bad.cpp '#include "platform/sqlite/Engine.h"'
Tells "A real part below app/" "knows no real part of the platform"
NewHouse; Put src/core/game/Bad.cpp '#include <QString>'
Tells "The toolkit in the logic" "knows no toolkit"
NewHouse; Put src/core/game/Bad.cpp '#include "sim/line/Wire.h"'
Tells "The venue in the program" "src/ does not include sim/"
NewHouse; Put sim/line/Bad.cpp '#include "core/game/Game.h"'
Tells "The program in the venue" "sim/ does not include src/"
NewHouse; Put src/app/Bad.cpp '#include "tests/core/Fake.h"'; Put tests/core/Fake.h
Tells "A test in the program" "src/ does not include tests/"
NewHouse; Put src/members/Bad.cpp '#include "Rows.h"'
Tells "An include beside the file" '"Rows.h" lies below no include root'
NewHouse; Put src/members/Bad.cpp '#include "../members/Rows.h"'
Tells "An include by way of the parent" '"../members/Rows.h" lies below no include root'
NewHouse; Put src/members/Bad.cpp '#include "src/members/Rows.h"'
Tells "An include from the repository's root" '"src/members/Rows.h" lies below no include root'
NewHouse; Put src/members/Bad.cpp '#include "ui_Absent.h"'
Tells "A form that is not beside the file" '"ui_Absent.h" lies below no include root'
NewHouse; Put tests/core/game/BadTest.cpp '#include "members/Rows.h"'
Tells "A test above its floor" "a test of a lower floor includes src/members/Rows.h"
NewHouse; Put src/core/newroom/Orphan.h
Tells "A header that nothing includes" "src/core/newroom/Orphan.h: included by no source"
exit $faults
