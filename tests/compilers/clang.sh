#!/usr/bin/env bash
# clang.sh: builds the neutral libraries and the hosts without a screen with clang++ (preset clang), and runs their tests.
set -euo pipefail
cd "$(dirname "${BASH_SOURCE[0]}")/../.."

jobs=2
targets=()
test_folders=()
for folder in frame fileservices controls hosts; do
    [[ -f $folder/CMakeLists.txt ]] || continue
    targets+=("$folder/all")
    if [[ -f tests/$folder/CMakeLists.txt ]]; then
        targets+=("tests/$folder/all")
        test_folders+=("build/clang/tests/$folder")
    fi
done

said=$(cmake --preset clang 2>&1) || { echo "$said"; exit 1; }
cmake --build --preset clang --parallel $jobs --target "${targets[@]}"
for folder in "${test_folders[@]}"; do
    ctest --test-dir "$folder" --parallel $jobs --output-on-failure --no-tests=error
done
