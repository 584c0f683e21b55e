#!/usr/bin/env bash
# Lines of C and C++ (every line of *.c, *.cpp, *.h) in the product folders
# and in tests/, per folder, and the share of the tests: the house rule is at
# most half of the product's lines (a third of product and tests together).
# Counts the files git knows, so build folders never count.
set -euo pipefail
cd "$(dirname "$0")/.."

count() { xargs -r cat | wc -l; }
sources() { git ls-files -- "$@" | grep -E '\.(c|cpp|h)$' || true; }

product=0
echo "product folder      lines"
for folder in $(git ls-files | grep -E '\.(c|cpp|h)$' | cut -d/ -f1 | sort -u); do
  case "$folder" in tests | fuzz | bench | *.*) continue ;; esac
  n=$(sources "$folder" | count)
  product=$((product + n))
  printf '  %-16s %6d\n' "$folder" "$n"
done
echo
tests=0
echo "test folder         lines"
for folder in $(git ls-files tests | grep -E '\.(c|cpp|h)$' | cut -d/ -f2 | sort -u); do
  n=$(sources "tests/$folder" | count)
  tests=$((tests + n))
  printf '  %-16s %6d\n' "$folder" "$n"
done
echo
printf 'product %d, tests %d: tests are %d%% of the product (at most 50%%), %d%% of all\n' \
  "$product" "$tests" $((100 * tests / product)) $((100 * tests / (tests + product)))
