# Puts sources together that can be compiled as one: up to `most`, below the same configuration of clang-tidy, in the same
# language, all with windows or none, and none of them with a name of another. Reads the folders that have such a
# configuration, then a line for each source: its flags as they stand in a compile command, a tab, its path. Writes for each
# group a folder below that of its configuration in `scratch`, with all.cpp and a database of compile commands, and prints
# the path of each all.cpp.
#
# The names are those at the start of a line: what a source keeps for itself, and its tests. A name that is missed here only
# costs time: the group does not compile and is split. One source's name may hide another's, so shadowing is left to the
# compilers.

NR == FNR { configured[$0]; next }

{
  path = $2
  folder = path
  do sub("/?[^/]*$", "", folder); while (folder != "" && !(folder in configured))
  kind = match($1, /-std=[^ ]+/) ? substr($1, RSTART, RLENGTH) : ""
  kind = folder " " kind ($1 ~ /QT_WIDGETS_LIB/)
  FindNames(path)
  for (group = 1; group <= groups; group++) {
    if (Fits(group, kind)) break
  }
  if (group > groups) groups = group
  folderOf[group] = folder
  kindOf[group] = kind
  sources[group] = sources[group] "#include \"" root "/" path "\"\n"
  count[group]++
  for (name in names) taken[group, name]
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

function Fits(group, kind,  name) {
  if (count[group] >= most || kindOf[group] != kind) return 0
  for (name in names) if ((group, name) in taken) return 0
  return 1
}

# Names that two sources of a group must not share.
function FindNames(path,  line, hidden) {
  delete names
  while ((getline line < path) > 0) {
    if (line == "namespace {") hidden = 1
    else if (line == "}  // namespace") hidden = 0
    else if (match(line, /^#define [A-Za-z0-9_]+/)) names[substr(line, 9, RLENGTH - 8)]
    else if (match(line, /^(TEST|MATCHER|INSTANTIATE)[A-Z_0-9]*\([A-Za-z0-9_]+(, [A-Za-z0-9_]+)?/)) names[substr(line, RSTART, RLENGTH)]
    else if (line ~ /^int main\(|LLVMFuzzerTestOneInput/) names["main"]
    else if (hidden && line ~ /^[A-Za-z]/ && line !~ /^(template|namespace|static_assert|using namespace|using [a-z]+::)/) names[NameIn(line)]
  }
  close(path)
}

# What a line at the start of a declaration declares.
function NameIn(line) {
  if (match(line, /^(class|struct|union|enum class|enum|using) [A-Za-z0-9_]+/)) line = substr(line, RSTART, RLENGTH)
  sub(/(\(| = |=$|\{|\[|;).*/, "", line)
  sub(/ +$/, "", line)
  sub(/.*[ *&]/, "", line)
  return line
}

# Each flag once, in the order in which it first comes; of a macro the first definition.
function AddFlags(group, text,  words, number, i, flag, key) {
  number = split(text, words, " ")
  for (i = 1; i <= number; i++) {
    flag = words[i]
    if (flag == "-isystem") flag = flag " " words[++i]
    key = flag
    if (flag ~ /^-D/) sub(/=.*/, "", key)
    if (!((group, "flag", key) in taken)) {
      taken[group, "flag", key]
      flags[group] = flags[group] (flags[group] == "" ? "" : " ") flag
    }
  }
}
