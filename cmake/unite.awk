# Prints for each source named on the command line the number of its group and its path. With tools/source_names.awk.

BEGIN {
  for (i = 1; i < ARGC; i++) print GroupOf(ARGV[i], "") " " ARGV[i]
  exit
}
