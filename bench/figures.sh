#!/usr/bin/env bash
# Prints what the README says about size and build time, for a build folder made by `cmake --preset release`.
#
#   bench/figures.sh [BUILD]
set -euo pipefail
cd "$(dirname "${BASH_SOURCE[0]}")/.."
build=${1:-build/release}
generated=$build/generated/hqf/model
objects=$build/hqf/CMakeFiles/hqf_objects.dir

# sum COLUMN FILE...: a column of size(1) over object files.
sum() { local column=$1; shift; size "$@" | awk -v c="$column" 'NR > 1 { total += $c } END { print total }'; }

mapfile -t engine < <(find "$objects/frame" -name '*.o')
tables=$(find "$objects" -name 'tables.cpp.o')
mapfile -t classes < <(find "$objects" -name 'classes_*.cpp.o')
count=$(find "$generated" -name '*.h' ! -name classes.h ! -name tables.h | wc -l)

echo "generated classes:            $count"
echo "rows:                         $(grep -cE '^ +HQF_(ATTRIBUTE|ELEMENT|GROUP|BODY|OPTION|WILDCARD)\(' "$generated/tables.cpp")"
echo "generated lines:              $(cat "$generated"/*.h "$generated"/*.cpp | wc -l)"
echo "engine, code bytes:           $(sum 1 "${engine[@]}")"
echo "tables, code and data bytes:  $(size "$tables" | awk 'NR == 2 { print $1 + $2 }')"
echo "classes, code bytes:          $(sum 1 "${classes[@]}"), $(($(sum 1 "${classes[@]}") / count)) a class"
strip -o "$build/hqf/stripped.so" "$build/hqf/libhqf.so"
echo "libhqf.so, stripped, bytes:   $(stat -c %s "$build/hqf/stripped.so")"
rm "$build/hqf/stripped.so"

echo '#include <hqf/hqf.h>' >"$build/include_all.cpp"
TIMEFORMAT="a file with <hqf/hqf.h>:      %R s to compile"
time g++ -std=c++20 -O2 -I. -I"$build/generated" -c "$build/include_all.cpp" -o "$build/include_all.o"
rm "$build/include_all.cpp" "$build/include_all.o"
echo "the library:                  time (cmake --build $build --target clean && cmake --build $build --target hqf)"
