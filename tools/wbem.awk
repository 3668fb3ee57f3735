# Reads what `wbemcli -nl` prints of instances (a path line, then "-Property=value" lines) and prints a table of the
# properties named in `columns` (blank-separated). `names` maps values to words: "Property:value=word ...".
BEGIN {
  count = split(columns, column, " ")
  pairs = split(names, pair, " ")
  for (i = 1; i <= pairs; i++) {
    at = index(pair[i], "=")
    word[substr(pair[i], 1, at - 1)] = substr(pair[i], at + 1)
  }
  for (i = 1; i <= count; i++) {
    width[i] = length(column[i])
  }
}

function keep() {
  if (!inside) return
  rows++
  for (i = 1; i <= count; i++) {
    text = column[i] in value ? value[column[i]] : ""
    if ((column[i] ":" text) in word) text = word[column[i] ":" text]
    cell[rows, i] = text == "" ? "-" : text
    if (length(cell[rows, i]) > width[i]) width[i] = length(cell[rows, i])
  }
  split("", value)
}

# Property lines begin with a dash; keys are marked with a leading hash.
/^-/ {
  line = substr($0, 2)
  at = index(line, "=")
  name = substr(line, 1, at - 1)
  sub(/^#/, "", name)
  sub(/\[\]$/, "", name)
  text = substr(line, at + 1)
  gsub(/^"|"$/, "", text)
  gsub(/","|,/, ", ", text)
  value[name] = text
  next
}

/./ { keep(); inside = 1 }

END {
  keep()
  for (i = 1; i <= count; i++) head = head sprintf("  %-*s", width[i], column[i])
  sub(/ +$/, "", head)
  print head
  for (row = 1; row <= rows; row++) {
    line = ""
    for (i = 1; i <= count; i++) line = line sprintf("  %-*s", width[i], cell[row, i])
    sub(/ +$/, "", line)
    print line
  }
  if (rows == 0) exit 1
}
