#!/usr/bin/env bash
# Builds what Kestrel needs on Windows from Debian's own source packages: ICU's common library with all converters and
# Xerces-C as DLLs, libcsv for the program; and copies the libraries that are headers alone.
#   usage: build-deps.sh PREFIX
# The parser is a DLL because plug-ins use its types: core and plug-ins must share one.
set -euo pipefail
prefix=$(realpath -m "$1")
here=$(dirname "$(realpath "$0")")
toolchain=$here/../../cmake/mingw-w64-x86_64.cmake
say() { printf '%s  [%4ds] %s\n' "$(date +%T)" "$SECONDS" "$*"; }

# What is built depends on this script and what it uses, and on the sources' versions, which are those of the installed
# system's package lists.
source_version() { apt-cache policy "$1" | sed -n 's/^ *Candidate: //p'; }
stamp="$(cat "$0" "$here/icu/CMakeLists.txt" "$toolchain" | sha256sum | cut -c1-16)"
for package in libicu-dev libxerces-c-dev libcsv-dev libcli11-dev nlohmann-json3-dev; do
  stamp+=" $package $(source_version $package)"
done
stamp+=" $(x86_64-w64-mingw32-g++-posix -dumpfullversion)"
if [ "$(cat "$prefix/stamp" 2>/dev/null)" = "$stamp" ]; then
  say "up to date: $prefix ($stamp)"
  exit 0
fi
rm -rf "$prefix"
mkdir -p "$prefix"
work=$(mktemp -d)
trap 'rm -rf "$work"' EXIT
quiet() { "$@" >"$work/log" 2>&1 || { tail -n 60 "$work/log"; exit 1; }; }

# The system's own lists need not have source packages: a private copy of its settings does.
say "fetching the sources"
mkdir -p "$work/apt/lists/partial" "$work/src"
cp -r /etc/apt "$work/apt/etc"
find "$work/apt/etc" -name '*.sources' -exec sed -i 's/^Types:.*/Types: deb-src/' {} +
find "$work/apt/etc" -name '*.list' -exec sed -i 's/^deb /deb-src /' {} +
apt=(apt-get -q -o "Dir::Etc=$work/apt/etc" -o "Dir::State::Lists=$work/apt/lists" -o APT::Sandbox::User=root)
quiet "${apt[@]}" update
(cd "$work/src" && quiet "${apt[@]}" source icu xerces-c libcsv)
icu=$(echo "$work"/src/icu-*/source) xerces=$(echo "$work"/src/xerces-c-*/)

common=(-G Ninja -DCMAKE_BUILD_TYPE=Release "-DCMAKE_TOOLCHAIN_FILE=$toolchain" "-DKESTREL_WINDOWS_DEPS=$prefix"
        "-DCMAKE_INSTALL_PREFIX=$prefix")
if command -v ccache >/dev/null; then
  common+=(-DCMAKE_C_COMPILER_LAUNCHER=ccache -DCMAKE_CXX_COMPILER_LAUNCHER=ccache)
fi
say "ICU's common library"
quiet cmake -S "$here/icu" -B "$work/icu" "${common[@]}" "-DICU_SOURCE=$icu"
quiet cmake --build "$work/icu" --parallel "$(nproc)"
quiet cmake --install "$work/icu"

# The program must never open a connection. Messages come from memory, because a message file would have to be found.
# Everything is exported, because the core derives from classes of the parser that are not marked for it.
say "Xerces-C"
quiet cmake -S "$xerces" -B "$work/xerces" "${common[@]}" -DBUILD_SHARED_LIBS=ON -Dnetwork=OFF -Dtranscoder=icu \
  -Dmessage-loader=inmemory -DCMAKE_CXX_FLAGS=-w -DCMAKE_SHARED_LINKER_FLAGS=-Wl,--export-all-symbols
quiet cmake --build "$work/xerces" --target xerces-c --parallel "$(nproc)"
quiet cmake --install "$work/xerces/src"

say "libcsv and what is headers alone"
csv=$(echo "$work"/src/libcsv-*/)
# A DLL, because its licence (LGPL) lets whoever has the program put another one in its place.
quiet x86_64-w64-mingw32-gcc-posix -O2 -shared "$csv/libcsv.c" -I "$csv" -o "$prefix/bin/libcsv.dll" \
  -Wl,--out-implib,"$prefix/lib/libcsv.dll.a"
cp "$csv/csv.h" "$prefix/include/"
mkdir -p "$prefix/share/cmake"
# Copied, because a link would lead the compiler into the system's own headers.
cp -r /usr/include/CLI /usr/include/nlohmann "$prefix/include/"
cp -r /usr/share/cmake/CLI11 /usr/share/cmake/nlohmann_json "$prefix/share/cmake/"

mkdir -p "$prefix/licences"
cp "$work"/src/icu-*/LICENSE "$prefix/licences/ICU.txt"
cp "$xerces/LICENSE" "$prefix/licences/Xerces-C.txt"
cp "$xerces/NOTICE" "$prefix/licences/Xerces-C-NOTICE.txt"
cp "$csv/COPYING.LESSER" "$prefix/licences/libcsv.txt"
cp /usr/share/doc/libcli11-dev/copyright "$prefix/licences/CLI11.txt"
cp /usr/share/doc/nlohmann-json3-dev/copyright "$prefix/licences/nlohmann-json.txt"
for dll in "$prefix"/bin/*.dll; do x86_64-w64-mingw32-strip "$dll"; done
echo "$stamp" >"$prefix/stamp"
say "done: $prefix"
