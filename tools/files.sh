# For the other scripts in this folder: the project's own files.

# OurFiles PATTERN...: existing files that git lists, committed or just added. Without git the folder is searched.
OurFiles() {
  local file
  { git ls-files -- "$@" 2> /dev/null || FoundFiles "$@"; } | while IFS= read -r file; do
    [ ! -f "$file" ] || printf '%s\n' "$file"
  done
}

FoundFiles() {
  local pattern tests=()
  for pattern in "$@"; do
    tests+=(${tests[0]:+-o} -name "$pattern")
  done
  find . \( -name .git -o -name build -o -name demo-out \) -prune -o -type f \( "${tests[@]}" \) -print | sed 's,^\./,,' | sort
}
