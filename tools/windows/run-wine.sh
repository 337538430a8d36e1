#!/bin/sh
# Runs one Windows program under Wine, without a display.   usage: run-wine.sh PROGRAM ARGUMENT...
set -eu
: "${WINEPREFIX:=${TMPDIR:-/tmp}/kestrel-wine-$(id -u)}"
# Quiet but for the line that names a missing DLL; without that the program just ends with code 53.
: "${WINEDEBUG:=-all,err+module}"
: "${WINEDLLOVERRIDES:=mscoree,mshtml,winemenubuilder.exe=;winedbg.exe=d}"
# In the C locale Wine can neither make a file with a name outside ASCII nor pass on such an argument.
: "${LC_ALL:=C.UTF-8}"
export WINEPREFIX WINEDEBUG WINEDLLOVERRIDES LC_ALL
unset DISPLAY || true
# Once in about a thousand starts the system's loader gives Wine up, with 127, before the program begins; that start is
# made again.
status=0
/usr/lib/wine/wine64 "$@" || status=$?
[ "$status" -ne 127 ] || exec /usr/lib/wine/wine64 "$@"
exit "$status"
