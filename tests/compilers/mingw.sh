#!/usr/bin/env bash
# mingw.sh: builds for Windows with mingw-w64 (preset mingw), and runs the tests under Wine. Where these are not installed it
# says so and succeeds.
set -euo pipefail
cd "$(dirname "${BASH_SOURCE[0]}")/../.."

jobs=2
export WINEPREFIX=$PWD/build/mingw/wine WINEDEBUG=-all WINEDLLOVERRIDES=mscoree,mshtml=
unset DISPLAY

missing=()
command -v x86_64-w64-mingw32-g++-posix >/dev/null || missing+=(g++-mingw-w64-x86-64-posix)
command -v wine >/dev/null && command -v wineserver >/dev/null || missing+=(wine wine64)
[[ -f /usr/src/googletest/CMakeLists.txt ]] || missing+=(googletest)
if [[ ${#missing[@]} != 0 ]]; then
    echo "SKIPPED: nothing was built for Windows or run under Wine. It needs Debian's packages ${missing[*]}"
    exit 0
fi

said=$(cmake --preset mingw 2>&1) || { echo "$said"; exit 1; }
cmake --build --preset mingw --parallel $jobs

# A Wine that stays for all tests: else each program starts and ends one of its own, which takes seconds. What it says goes to
# a file, since a pipe would stay open for as long as Wine runs.
mkdir -p "$WINEPREFIX"
said=build/mingw/wine.log
trap 'wineserver --kill &>/dev/null || true' EXIT
wineserver --persistent &>/dev/null || true # one may be running
timeout 120 wine wineboot --init &>"$said" </dev/null || { echo "Wine does not start:"; cat "$said"; exit 1; }
ctest --preset mingw --parallel $jobs --no-tests=error
