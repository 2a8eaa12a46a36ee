# Makes the table of the rows in rows.txt and the measured figures: awk -f table.awk FACTS ROWS, with -v markdown=1 for
# a table in Markdown. A line of FACTS is: row, number of events, quantity, figure, separated by tabs.

BEGIN {
  kFigures = 3
  kColumns = 5 + kFigures
  split("53 9 9 9 8 14 14 0", width, " ")
  title = markdown ? "**%s**" : "%s"
}

FNR == NR {
  split($0, fact, "\t")
  # Instructions are counted over one recording alone.
  if (fact[3] == "instructions") instructions[fact[1]] = fact[4]
  figure[fact[1], fact[3], fact[2]] = fact[4]
  counts[fact[1], fact[3]] = counts[fact[1], fact[3]] " " fact[2]
  next
}

/^#/ || /^$/ { next }

/:$/ {
  start_section(substr($0, 1, length($0) - 1))
  next
}

{
  split($0, field, " *\\| *")
  add_row(field[1], field[2], field[3], field[4])
}

function start_section(heading) {
  first = ""
  split("", cell)
  section = heading
}

# The first row of a section says for which numbers of events there are figures.
function finish_heading(row, quantity,    i) {
  first = row
  figures = split(counts[row, quantity], events, " ")
  if (!figures) return
  cell[1] = sprintf(title, section)
  for (i = 1; i <= figures; ++i) cell[1 + i] = events[i] > 0 ? grouped(events[i]) : ""
  if (quantity == "ns") {
    cell[2 + kFigures] = "MB/s"
    cell[3 + kFigures] = "instructions"
    cell[4 + kFigures] = "vesk / this"
    cell[5 + kFigures] = "goal"
  }
  if (!markdown && has_output) print ""
  if (markdown && !has_output) print_rule()
  has_output = 1
  print_cells()
}

function add_row(row, quantity, what, goal,    i, value, ratio, ratios, is_met) {
  if (first == "") finish_heading(row, quantity)
  if (!((row, quantity) in counts)) return
  split("", cell)
  cell[1] = (markdown ? "" : "  ") what
  is_met = 1
  for (i = 1; i <= figures; ++i) {
    if (!((row, quantity, events[i]) in figure)) continue
    value = figure[row, quantity, events[i]]
    cell[1 + i] = rounded(value)
    if ((row, "MB/s", events[i]) in figure) cell[2 + kFigures] = rounded(figure[row, "MB/s", events[i]])
    ratio = figure[first, quantity, events[i]] / value
    is_met = is_met && meets(goal, quantity, events[i], value, ratio)
    ratios = ratios (ratios == "" ? "" : " ") sprintf(ratio < 0.2 ? "%.3f" : "%.2f", ratio)
  }
  if (quantity == "ns") {
    if (row in instructions) cell[3 + kFigures] = sprintf("%.0f", instructions[row])
    if (row != first) cell[4 + kFigures] = ratios
  }
  sub(/^ratio /, "", goal)
  if (goal != "") cell[kColumns] = "<= " goal (is_met ? ": met" : ": missed")
  print_cells()
}

# N, "ratio N", or "N or ROW + M", where ROW has a figure for the same number of events.
function meets(goal, quantity, count, value, ratio,    word, words) {
  words = split(goal, word, " ")
  if (word[1] == "ratio") return ratio <= word[2]
  if (value <= word[1]) return 1
  return words == 5 && (word[3], quantity, count) in figure && value <= figure[word[3], quantity, count] + word[5]
}

function rounded(value) {
  return sprintf(value >= 100 ? "%.0f" : value >= 10 ? "%.1f" : "%.2f", value)
}

function grouped(number,    text) {
  text = ""
  while (length(number) > 3) {
    text = "," substr(number, length(number) - 2) text
    number = substr(number, 1, length(number) - 3)
  }
  return number text
}

function print_cells(    i, line) {
  if (markdown) {
    for (i = 1; i <= kColumns; ++i) line = line "| " cell[i] (cell[i] == "" ? "" : " ")
    print line "|"
    return
  }
  for (i = 1; i < kColumns; ++i) line = line sprintf("%" (i == 1 ? "-" : "") width[i] "s", cell[i])
  if (cell[kColumns] != "") line = line "   " cell[kColumns]
  sub(/ +$/, "", line)
  print line
}

# Markdown wants a header; the sections have their own.
function print_rule(    i, line) {
  for (i = 1; i <= kColumns; ++i) line = line "| "
  print line "|"
  line = ""
  for (i = 1; i <= kColumns; ++i) line = line (i == 1 || i == kColumns ? "| --- " : "| ---: ")
  print line "|"
}
