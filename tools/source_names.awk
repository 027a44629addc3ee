# For scripts that compile several sources as one: puts those together, up to `most`, that have no name in common. The names
# are those at the start of a line: what a source keeps for itself, and its tests.

# The group of the next source: the first that has room for it among those of its kind, or a new one. The number of groups is
# `groups`.
function GroupOf(path, kind,  group, name) {
  FindNames(path)
  for (group = 1; group <= groups; group++) {
    if (Fits(group, kind)) break
  }
  if (group > groups) groups = group
  kindOf[group] = kind
  count[group]++
  for (name in names) taken[group, name]
  return group
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
