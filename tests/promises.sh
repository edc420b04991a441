#!/usr/bin/env bash
# Every test that docs/promises.md names exists.
set -euo pipefail
cd "$1"
missing=0
for name in $(grep -oE '`[A-Z][A-Za-z0-9]+\.[A-Za-z0-9]+`' docs/promises.md | tr -d '`' | sort -u); do
  if ! grep -rqE "TEST(_F|_P)?\(${name%.*}, ${name#*.}\)|add_test\(NAME (${name}|${name%.*}\.\\$)" \
    tests --include=*.cpp --include=CMakeLists.txt; then
    echo "docs/promises.md names $name, which is no test" >&2
    missing=1
  fi
done
exit $missing
