#!/bin/sh
# Usage: wine.sh PREFIX PROGRAM [ARGUMENT]...
# Runs a Windows program. Wine keeps its registry and drives in PREFIX; its loader need not be on the path.
prefix=$1
shift
# File names are UTF-8 whatever the locale; what decides about texts stays as it is.
texts=${LC_ALL:-${LC_MESSAGES:-${LANG:-C}}}
PATH=$PATH:/usr/lib/wine
exec env -u LC_ALL LC_MESSAGES="$texts" LC_CTYPE=C.UTF-8 \
    WINEPREFIX="$prefix" WINEDEBUG=-all WINEDLLOVERRIDES=mscoree,mshtml= wine64 "$@"
