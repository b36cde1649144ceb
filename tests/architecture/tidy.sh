#!/usr/bin/env bash
# tidy.sh [file...]: runs clang-tidy with the project's .clang-tidy over the named sources, or over all of the library's.
# Takes some seconds a file, so that it is run by hand and not by ctest.
set -euo pipefail
cd "$(dirname "${BASH_SOURCE[0]}")/../.."

folders=(frame fileservices controls hosts/headless hosts/posix tools)
if [[ $# == 0 ]]; then
    present=()
    for folder in "${folders[@]}"; do [[ -d $folder ]] && present+=("$folder"); done
    mapfile -t files < <(find "${present[@]}" -name '*.cpp' | sort)
else
    files=("$@")
fi
printf '%s\0' "${files[@]}" | xargs -0 -P 2 -I{} clang-tidy --quiet {} -- -std=c++20 -I. 2> >(grep -vE '^[0-9]+ warnings? ' >&2)
echo "clang-tidy has nothing to say about ${#files[@]} files."
