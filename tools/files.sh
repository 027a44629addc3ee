# For the scripts beside it: the files that are ours.

# OurFiles PATTERN...: what git lists (committed or only added) and still exists. A tree without git is searched instead.
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
