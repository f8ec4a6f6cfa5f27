#!/usr/bin/env bash
# build.sh: what a fuzzing service calls. Builds every target into $OUT, each with its seeds, its dictionary
# and its options beside it, and the libraries it needs in $OUT/lib. Uses CC, CXX, CFLAGS, CXXFLAGS and
# LIB_FUZZING_ENGINE, as the service sets them, and the packages of `scripts/setup build`.
set -euo pipefail
root=$(cd "$(dirname "${BASH_SOURCE[0]}")/.." && pwd)
: "${OUT:?}" "${LIB_FUZZING_ENGINE:=-fsanitize=fuzzer}"

build=$(mktemp -d)
trap 'rm -rf "$build"' EXIT
cmake -S "$root" -B "$build" -G Ninja -D DPXLSX_FUZZ=ON -D DPXLSX_FUZZ_ENGINE="$LIB_FUZZING_ENGINE" \
    -D DPXLSX_TOOL=OFF -D DPXLSX_UNITY=ON -D CMAKE_BUILD_WITH_INSTALL_RPATH=ON \
    -D "CMAKE_INSTALL_RPATH=\$ORIGIN/lib"
cmake --build "$build" --target fuzzers

mkdir -p "$OUT/lib"
for seeds in "$build"/fuzz/seeds/*/; do
    target=$(basename "$seeds")
    cp "$build/fuzz/$target" "$root/fuzz/dictionaries/$target.dict" "$root/fuzz/options/$target.options" "$OUT"
    before=$root/fuzz/found/$target
    [ ! -d "$before" ] || cp "$before"/* "$seeds"
    rm -f "$OUT/${target}_seed_corpus.zip"
    (cd "$seeds" && cmake -E tar cf "$OUT/${target}_seed_corpus.zip" --format=zip -- *)
    # The machine that runs the targets has no packages but those of the C and C++ libraries.
    ldd "$build/fuzz/$target" | sed -n 's/.* => \(\/[^ ]*\) .*/\1/p' |
        grep -vE '/(libc|libm|libdl|libpthread|librt|libgcc_s|libstdc\+\+|ld-linux[^/]*)\.so' |
        xargs -r cp -Lt "$OUT/lib"
done
