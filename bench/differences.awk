# Makes the table of bench/compare: awk -f differences.awk FACTS. A line of FACTS is: row and side (ROW@old, ROW@new),
# number of events, quantity, figure, separated by tabs. Of a figure that comes more than once the least counts.

BEGIN { FS = "\t" }

$3 == "MB/s" || $1 ~ /^message@/ || $1 !~ /vesk|^decode@|^stores@/ { next }

{
  split($1, name, "@")
  key = name[1] FS $2 FS $3
  if (!(key in is_known)) {
    is_known[key]
    keys[++count] = key
  }
  if (!((key, name[2]) in figure) || $4 < figure[key, name[2]]) figure[key, name[2]] = $4
}

END {
  kLine = "%-24s%9s  %-14s%10s%10s%10s\n"
  printf kLine, "", "events", "", "old", "new", "new / old"
  for (i = 1; i <= count; ++i) {
    key = keys[i]
    if (!((key, "old") in figure) || !((key, "new") in figure)) continue
    split(key, part, FS)
    printf kLine, part[1], part[2], part[3], rounded(figure[key, "old"]), rounded(figure[key, "new"]), \
      sprintf("%.3f", figure[key, "new"] / figure[key, "old"])
  }
}

function rounded(value) {
  return sprintf(value >= 100 ? "%.0f" : value >= 10 ? "%.1f" : "%.2f", value)
}
