# For tools/floors, which passes its tables in the environment. Reads lines "file PATH" and then "include PATH NAME",
# separated by tabs, NAME with its opening quote or bracket.

function Fault(text) {
  print text
  faults++
}

function Folder(path) { return path ~ /\// ? substr(path, 1, match(path, /\/[^\/]*$/) - 1) : "." }
function Root(path) { sub(/\/.*/, "", path); return path }
function Unsuffixed(path) { sub(/\.[^.\/]*$/, "", path); return path }
function Starts(text, start) { return substr(text, 1, length(start)) == start }

# "x" stands for the folder x and all below it, "x/*" only for what is below, "*" for everything.
function Matches(folder, pattern) {
  if (pattern !~ /\*$/) return Starts(folder "/", pattern "/")
  return Starts(folder, substr(pattern, 1, length(pattern) - 1))
}

# The number of the longest of `count` patterns that fits, or of the one that is the folder's name; 0 if none fits.
function Best(folder, patterns, count,    i, best) {
  best = 0
  for (i = 1; i <= count; ++i) {
    if (patterns[i] == folder) return i
    if (Matches(folder, patterns[i]) && (!best || length(patterns[i]) > length(patterns[best]))) best = i
  }
  return best
}

# A subject is a folder directly below src/; in devices/, each folder is one.
function Subject(folder,    names) {
  split(folder, names, "/")
  return names[1] == "devices" ? names[1] "/" names[2] : names[1]
}

function FloorName(folder,    floor) {
  floor = floors[Best(folder, floors, floorCount)]
  return floor == "*" ? "subject" : floor
}

function Excepted(from, to,    i) {
  for (i = 1; i <= exceptionCount; ++i) {
    if (Matches(from, exceptFrom[i]) && Matches(to, exceptTo[i])) return 1
  }
  return 0
}

function ReadTables(    lines, count, i, fields) {
  count = split(ENVIRON["floors"], lines, "\n")
  for (i = 1; i <= count; ++i) if (lines[i] != "") floors[++floorCount] = lines[i]
  count = split(ENVIRON["roots"], lines, "\n")
  for (i = 1; i <= count; ++i) if (split(lines[i], fields, " ")) mayUse[fields[1]] = " " lines[i] " "
  count = split(ENVIRON["parts"], lines, "\n")
  for (i = 1; i <= count; ++i) if (split(lines[i], fields, " ")) {
    parts[++partCount] = fields[1]
    partUsers[partCount] = " " lines[i] " "
  }
  count = split(ENVIRON["exceptions"], lines, "\n")
  for (i = 1; i <= count; ++i) if (split(lines[i], fields, " ")) {
    exceptFrom[++exceptionCount] = fields[1]
    exceptTo[exceptionCount] = fields[2]
  }
}

# The path of what `file` includes as "name"; "" if it is below no include root.
function Resolved(file, name,    form) {
  if (("src/" name) in exists) return "src/" name
  if (name ~ /^(src|\.)\// || name ~ /(^|\/)\.\.\//) return ""
  if (name in exists) return name
  if (name ~ /^ui_[^\/]*\.h$/) {  # generated from the form beside the file
    form = Folder(file) "/" substr(Unsuffixed(name), 4) ".ui"
    if (form in exists) return form
  }
  return ""
}

function CheckWithinProgram(file, target, from, to,    part) {
  if (Best(to, floors, floorCount) > Best(from, floors, floorCount)) {
    Fault(file ": includes upwards: " target)
    return
  }
  part = Best(to, parts, partCount)
  if (part && !Matches(from, Root(parts[part])) && index(partUsers[part], " " FloorName(from) " ") == 0 &&
      !Excepted(from, to)) {
    Fault(file ": " FloorName(from) " knows no real part of the platform: " target)
  }
  if (FloorName(from) != "subject" || FloorName(to) != "subject" || Subject(from) == Subject(to)) return
  if (Excepted(from, to)) return
  if (Root(from) == "devices" && Root(to) == "devices") {
    Fault(file ": rooms of devices do not know each other: " target)
  } else if (Unsuffixed(target) in window) {
    Fault(file ": includes the window of another subject: " target)
  }
}

function CheckTest(file, target, from, to) {
  sub(/^tests\//, "", from)
  if (from == "tests" || from ~ /^(support|fakes|fuzz|soak|sim|tools)(\/|$)/) return
  if (Best(to, floors, floorCount) > Best(from, floors, floorCount) && !Excepted("tests/" from, to)) {
    Fault(file ": a test of a lower floor includes " target)
  }
}

function Check(file, name,    target, from, to) {
  target = Resolved(file, name)
  if (target == "") {
    Fault(file ": \"" name "\" lies below no include root")
    return
  }
  includes[file] = includes[file] "\n" target
  from = Folder(file)
  to = Folder(target)
  # A test makes no folder depend on another, since nothing includes it.
  if (from != to && ++uses[from, to] && file !~ /Test\.cpp$/ && !linked[from, to]++) edges[from] = edges[from] "\n" to
  if (index(mayUse[Root(file)], " " Root(target) " ") == 0) {
    Fault(file ": " Root(file) "/ does not include " Root(target) "/: " target)
  } else if (Root(target) == "src") {
    sub(/^src\//, "", to)
    if (Root(file) == "src") CheckWithinProgram(file, target, substr(from, 5), to)
    if (Root(file) == "tests") CheckTest(file, target, from, to)
  }
}

# Depth first; `path` is the way to `folder`.
function FindCircle(folder, path,    next_, count, i) {
  state[folder] = "open"
  count = split(edges[folder], next_, "\n")
  for (i = 1; i <= count; ++i) {
    if (next_[i] == "") continue
    if (state[next_[i]] == "open") {
      path = path " -> " folder " -> " next_[i]
      Fault("circle: " substr(path, index(path, " " next_[i] " ->") + 1))
    } else if (state[next_[i]] == "") {
      FindCircle(next_[i], path " -> " folder)
    }
  }
  state[folder] = "done"
}

# A header that no source reaches is neither compiled nor checked.
function Reach(file,    next_, count, i) {
  if (reached[file]++) return
  count = split(includes[file], next_, "\n")
  for (i = 1; i <= count; ++i) if (next_[i] != "") Reach(next_[i])
}

BEGIN { ReadTables() }

$1 == "file" {
  exists[$2] = 1
  if ($2 ~ /\.(cpp|h)$/) code[++codeCount] = $2
}

$1 == "include" {
  if ($3 ~ /^<Q[A-Z]/ || $3 ~ /^"ui_/) window[Unsuffixed($2)] = 1
  if ($3 ~ /^<Q[A-Z]/ && $2 ~ /^(sim|src\/core|src\/platform\/[^\/]*$)/) Fault($2 ": knows no toolkit: " $3 ">")
  if ($3 ~ /^"/) {
    includer[++includeCount] = $2
    included[includeCount] = substr($3, 2)
  }
}

END {
  for (i = 1; i <= includeCount; ++i) Check(includer[i], included[i])
  for (i = 1; i <= codeCount; ++i) if (state[Folder(code[i])] == "") FindCircle(Folder(code[i]), "")
  for (i = 1; i <= codeCount; ++i) if (code[i] ~ /\.cpp$/) Reach(code[i])
  for (i = 1; i <= codeCount; ++i) if (!(code[i] in reached)) Fault(code[i] ": included by no source")
  if (graph == "--graph") {
    for (edge in uses) {
      split(edge, ends, SUBSEP)
      print ends[1] " -> " ends[2] " (" uses[edge] ")" | "sort"
    }
  }
  exit faults > 0
}
