# Puts sources together that can be compiled as one: up to `most`, below the same configuration of clang-tidy, in the same
# language, all with windows or none, and none of them with a name of another. Reads the folders that have such a
# configuration, then a line for each source: its flags as they stand in a compile command, a tab, its path. Writes for each
# group a folder below that of its configuration in `scratch`, with all.cpp and a database of compile commands, and prints
# the path of each all.cpp.
#
# A name that source_names.awk does not find only costs time: the group does not compile and is split. One source's name may
# hide another's, so shadowing is left to the compilers.

NR == FNR { configured[$0]; next }

{
  path = $2
  folder = path
  do sub("/?[^/]*$", "", folder); while (folder != "" && !(folder in configured))
  kind = match($1, /-std=[^ ]+/) ? substr($1, RSTART, RLENGTH) : ""
  kind = folder " " kind ($1 ~ /QT_WIDGETS_LIB/)
  group = GroupOf(path, kind)
  folderOf[group] = folder
  sources[group] = sources[group] "#include \"" root "/" path "\"\n"
  AddFlags(group, $1)
}

END {
  for (group = 1; group <= groups; group++) {
    place = scratch "/" folderOf[group] "/" group
    system("mkdir -p '" place "'")
    printf "%s", sources[group] > (place "/all.cpp")
    close(place "/all.cpp")
    printf "[\n{\n  \"directory\": \"%s\",\n  \"command\": \"%s -Wno-shadow -c all.cpp\",\n  \"file\": \"%s/all.cpp\"\n}\n]\n", place, flags[group], place > (place "/compile_commands.json")
    close(place "/compile_commands.json")
    print place "/all.cpp"
  }
}

# Each flag once, in the order in which it first comes; of a macro the first definition.
function AddFlags(group, text,  words, number, i, flag, key) {
  number = split(text, words, " ")
  for (i = 1; i <= number; i++) {
    flag = words[i]
    if (flag == "-isystem") flag = flag " " words[++i]
    key = flag
    if (flag ~ /^-D/) sub(/=.*/, "", key)
    if (!((group, key) in seen)) {
      seen[group, key]
      flags[group] = flags[group] (flags[group] == "" ? "" : " ") flag
    }
  }
}
