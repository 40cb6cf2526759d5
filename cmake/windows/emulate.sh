#!/bin/sh
# Runs a program for Windows with wine, whose files are in the folder of builds: emulate.sh PROGRAM [ARGUMENTS...]
here=$(dirname "$(readlink -f "$0")")
WINEPREFIX=${GAITWRIGHT_WINEPREFIX:-$here/../../build/wine}
WINEDEBUG=-all
HOME=$WINEPREFIX # where wine leaves files of its own
export WINEPREFIX WINEDEBUG HOME
mkdir -p "$WINEPREFIX"
wine=$(PATH=$PATH:/usr/lib/wine command -v wine64) || wine=/usr/lib/wine/wine64
exec "$wine" "$@"
