#!/usr/bin/env bash
# SPDX-License-Identifier: MIT
# check-file-types.sh MIME_XML [CORPUS]: with only MIME_XML added to the MIME database, in a
# temporary XDG_DATA_HOME, LDraw part files are application/x-ldraw, whatever their name's case
# and line ends, and other ".dat" files are not: plain text, random bytes, an empty file.
set -euo pipefail
mime_xml="$1"
corpus="${2:-}"
data="$(mktemp -d)"
trap 'rm -rf "$data"' EXIT
mkdir -p "$data/mime/packages" "$data/files"
cp "$mime_xml" "$data/mime/packages/"
XDG_DATA_HOME="$data" update-mime-database "$data/mime"
cd "$data/files"

printf '0 Brick  1 x  2\n0 Name: 3004.dat\n0 Author: Sam Sample [ssample]\n' >part.dat
printf '\xef\xbb\xbf0 Brick  1 x  2\r\n0 Name: 3004.dat\r\n' >bom.dat
printf '0 ~Moved to 3004\r\n 1 16 0 0 0 1 0 0 0 1 0 0 0 1 3004.dat\r\n' >MOVED.DAT
printf 'Shopping list\n0 eggs\n1 loaf\n' >notes.dat
printf '0 apples\nand pears\n' >counts.dat
head -c 4096 /dev/urandom >random.dat
: >empty.dat
expected="bom.dat: application/x-ldraw
counts.dat: text/plain
empty.dat: text/plain
MOVED.DAT: application/x-ldraw
notes.dat: text/plain
part.dat: application/x-ldraw"

types() { XDG_DATA_HOME="$data" gio info -a standard::content-type "$@" | awk '/^uri:/ { n = split($2, p, "/"); name = p[n] } /content-type:/ { print name ": " $2 }'; }
actual="$(types bom.dat counts.dat empty.dat MOVED.DAT notes.dat part.dat)"
[ "$actual" = "$expected" ] || { printf 'file types differ:\n%s\nexpected:\n%s\n' "$actual" "$expected"; exit 1; }
random="$(types random.dat)"
[ "$random" = "random.dat: application/octet-stream" ] || { echo "$random"; exit 1; }

if [ -n "$corpus" ] && [ -d "$corpus" ]; then
    others="$(find "$corpus" -iname '*.dat' -print0 | XDG_DATA_HOME="$data" xargs -0 gio info -a standard::content-type |
              grep 'standard::content-type:' | grep -v -c 'application/x-ldraw$' || true)"
    [ "$others" -eq 0 ] || { echo "$others corpus files are not application/x-ldraw"; exit 1; }
fi
echo "file types claimed as they should be"
