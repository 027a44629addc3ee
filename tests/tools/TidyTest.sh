#!/usr/bin/env bash
# tools/tidy looks into each header of ours, wherever it lies, in a small repository made for it.
set -euo pipefail
source=$(cd "$(dirname "$0")/../.." && pwd)
house=$(mktemp -d)
trap 'rm -rf "$house"' EXIT
faults=0

Put() {
  mkdir -p "$house/$(dirname "$1")"
  printf '%s\n' "$2" > "$house/$1"
}

# The commands of the sources of the house that a target builds.
Compile() {
  local file commands=
  for file in "$@"; do
    commands+=${commands:+,$'\n'}$(printf '{\n  "directory": "%s",\n  "command": "clang++ -I%s/src -I%s/build/made -c %s/%s",\n  "file": "%s/%s"\n}' \
      "$house" "$house" "$house" "$house" "$file" "$house" "$file")
  done
  printf '[\n%s\n]\n' "$commands" > "$house/build/asan/compile_commands.json"
}

# Tells NAME EXPECTED [FILE...]: tools/tidy fails, and names what is wrong.
Tells() {
  local name=$1 expected=$2 output
  shift 2
  if output=$("$house/tools/tidy" "$@" 2>&1); then
    echo "$name: not noticed"
    faults=1
  elif ! grep -qF -- "$expected" <<< "$output"; then
    printf '%s: told as\n%s\n' "$name" "$output"
    faults=1
  fi
}

Passes() {
  local output
  output=$("$house/tools/tidy" 2>&1) || { printf '%s:\n%s\n' "$1" "$output"; faults=1; }
}

bad='inline int* Nothing() { return 0; }'
good='inline int* Nothing() { return nullptr; }'
mkdir -p "$house/tools" "$house/build/asan"
cp "$source"/tools/{tidy,tidy_groups.awk,source_names.awk,files.sh} "$house/tools"
cp "$source/.clang-tidy" "$house"
# Nothing is to be made here; the commands of sources alone are the same.
Put bin/cmake '#!/bin/sh
case "$*" in *" -B "*) mkdir -p "$4" && cp build/asan/compile_commands.json "$4" ;; esac'
chmod +x "$house/bin/cmake"
PATH=$house/bin:$PATH
printf '/build/\n/bin/\n' > "$house/.gitignore"
Put src/core/Game.cpp '#include "core/new.room/Deep.h"
#include "ui_Form.h"'
Put build/made/ui_Form.h 'inline int* FromTheForm() { return 0; }'
Compile src/core/Game.cpp
cd "$house"
git init -q .
git add .

Put src/core/new.room/Deep.h "$good"
git add .
Passes "Good headers, and one that the build makes"
Put src/core/new.room/Deep.h "$bad"
Tells "A header in a new folder, added" "src/core/new.room/Deep.h:1"
git -c user.name=test -c user.email=test@localhost commit -qm "Bad"
Put src/core/new.room/Deep.h "$bad"
Tells "A header in a new folder, committed" "src/core/new.room/Deep.h:1"
Put src/core/new.room/Deep.h "$good"
Put src/core/Game.cpp "$bad"
Tells "A source" "src/core/Game.cpp:1"
Tells "A source named" "src/core/Game.cpp:1" src/core/Game.cpp
Put src/core/Game.cpp "$good"
Put src/core/Lost.cpp "$good"
git add .
Tells "A source that no target builds" "src/core/Lost.cpp"
Put src/core/Lost.cpp 'This is no C++'
Compile src/core/Game.cpp src/core/Lost.cpp
Tells "A source that does not compile" "src/core/Lost.cpp"
exit $faults
