#!/usr/bin/env bash
# clang-tidy over the sources that changed since the last commit but one, or with --all over every source (minutes). A
# file found clean is not looked at again until it, a header, or the checks change.
#   scripts/lint.sh [--all]
set -uo pipefail
cd "$(dirname "$0")/.."
cache=build/lint
mkdir -p "$cache"
folders=()
for folder in src tests tools products bench fuzz; do [ -d $folder ] && folders+=("$folder"); done
# Any header may change what a source means: they all count.
common=$( (cat .clang-tidy; find "${folders[@]}" -name '*.h' | sort | xargs cat) | sha256sum | cut -c1-16)

# The compile commands without the tests' precompiled headers, which only their own compiler can read.
for build in host windows; do
  mkdir -p "$cache/$build"
  sed 's| -Winvalid-pch||; s| -include [^ ]*cmake_pch\.hxx||' build/$build/compile_commands.json >"$cache/$build/compile_commands.json"
done

# The cross-compiler's library headers; its own built-in ones would not suit another compiler.
windows_headers=$(i686-w64-mingw32-g++-posix -E -x c++ -v /dev/null 2>&1 >/dev/null |
  sed -n '/^#include <...>/,/^End of search/p' | grep '^ ' | grep -v 'lib/gcc/.*/include\(-fixed\)\?$' |
  xargs -n1 readlink -f | sed 's/^/--extra-arg=-isystem/')

lint_one() {
  local source=$1 key database=$cache/host target=()
  key=$cache/$( (echo "$2"; cat "$source") | sha256sum | cut -c1-32)
  [ -f "$key" ] && return 0
  # What only the Windows build compiles is read with its compiler's headers.
  if ! grep -q "/$source\"" $cache/host/compile_commands.json; then
    database=$cache/windows
    grep -q "/$source\"" $database/compile_commands.json || return 0
    target=(--extra-arg=--target=i686-w64-mingw32 $windows_headers)
  fi
  if clang-tidy-14 -quiet -p "$database" "${target[@]}" --extra-arg=-Wno-everything \
    --extra-arg=-fexec-charset=UTF-8 "$source" >"$key.log" 2>&1; then
    rm -f "$key.log"
    touch "$key"
  else
    grep -v 'warnings generated\|^Suppressed\|^Use -header' "$key.log"
    return 1
  fi
}
export -f lint_one
export cache windows_headers
sources() {
  if [ "$1" = --all ] || ! git rev-parse -q --verify HEAD~1 >/dev/null 2>&1; then
    find "${folders[@]}" -name '*.cpp'
  else
    { git diff --name-only --diff-filter=d HEAD~1; git ls-files --others --exclude-standard; } |
      grep -E "^($(IFS='|'; echo "${folders[*]}"))/.*\.cpp$" || true  # nothing changed
  fi
}
sources "${1:-}" | sort | xargs -P2 -I{} bash -c 'lint_one "$1" "$2"' _ {} "$common"
