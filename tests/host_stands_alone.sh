#!/usr/bin/env bash
# Builds and runs the sample application from a copy of the checkout that holds the platform and
# the host alone: no room that it may not know is there to be included.
set -euo pipefail
source=$1
work=$2
mkdir -p "$work/checkout"
for room in platform host; do
  rm -rf "$work/checkout/$room"
  cp -r "$source/$room" "$work/checkout/$room"
done
cp -r "$source/CMakeLists.txt" "$source/cmake" "$work/checkout/"
cmake -S "$work/checkout" -B "$work/build" -G Ninja -DCMAKE_CXX_FLAGS=-O0 >"$work/configure.log"
cmake --build "$work/build" --target tavro-host >"$work/build.log" || {
  cat "$work/build.log"
  exit 1
}
# Every screen must have something on it.
"$work/build/bin/tavro-host" "$source/host/data/diary.json" | tee "$work/screens.txt"
grep -q 'day: [1-9][0-9]* views' "$work/screens.txt"
if grep -q ': 0 views' "$work/screens.txt"; then
  exit 1
fi
