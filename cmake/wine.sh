#!/bin/sh
# Usage: wine.sh PREFIX PROGRAM [ARGUMENT]...
# Runs a Windows program. Wine keeps its registry and drives in PREFIX; its loader need not be on the path.
PATH=$PATH:/usr/lib/wine
export WINEPREFIX="$1" WINEDEBUG=-all WINEDLLOVERRIDES=mscoree,mshtml=
shift

# What Wine starts beside the first program outlives it, and would hold its output open. Signal 0 only asks whether
# Wine runs.
wineserver -k0 2>/dev/null || wine64 wineboot --init </dev/null >/dev/null 2>&1

# File names are UTF-8 whatever the locale; what decides about texts stays as it is.
exec env -u LC_ALL LC_MESSAGES="${LC_ALL:-${LC_MESSAGES:-${LANG:-C}}}" LC_CTYPE=C.UTF-8 wine64 "$@"
