#!/usr/bin/env bash
# Prints how many instructions a day of the month calendar costs, built and read, for calendars of
# 1, 10 and 30 years: the same for all of them where the cost is in proportion to the days.
# usage: slope.sh PROGRAM
set -euo pipefail
program=$1

# count YEARS: prints how many days were read, and the instructions of the whole run.
count() {
  local days log
  log=$(mktemp)
  if ! days=$(valgrind --tool=callgrind --callgrind-out-file=/dev/null \
    "$program" --count calendar "$1" 2>"$log"); then
    cat "$log" >&2
    rm -f "$log"
    return 1
  fi
  echo "$days $(awk '/Collected *:/ { print $NF }' "$log")"
  rm -f "$log"
}

none=$(count 0)
printf '%-6s %8s %18s %8s\n' YEARS DAYS INSTRUCTIONS/DAY 'TO 1 YEAR'
for years in 1 10 30; do
  read -r days instructions <<<"$(count "$years")"
  a_day=$(((instructions - ${none#* }) / days))
  [ "$years" -eq 1 ] && of_one=$a_day
  printf '%-6s %8s %18s %8s\n' "$years" "$days" "$a_day" \
    "$(awk "BEGIN { printf \"%.4f\", $a_day / $of_one }")"
done
