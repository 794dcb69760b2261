#!/usr/bin/env bash
# SPDX-License-Identifier: MIT
# Installs a build into a temporary folder as a package would, checks the layout, the file types claimed and the desktop identity, runs the installed
# quillmark-cli as a user with an empty home, and validates the desktop files with the
# freedesktop tools where they are installed.
set -euo pipefail
build_dir="$1"
corpus="${2:-}"
dest="$(mktemp -d)"
home="$(mktemp -d)"
trap 'rm -rf "$dest" "$home"' EXIT
DESTDIR="$dest" cmake --install "$build_dir" --prefix /usr >/dev/null
usr="$dest/usr"
id=io.github.quillmark.Quillmark
for file in bin/quillmark bin/quillmark-cli \
            share/quillmark/category.txt share/quillmark/parttype.txt share/quillmark/bfc.txt share/quillmark/licenses.txt share/quillmark/colourcodes.txt \
            share/applications/$id.desktop share/mime/packages/$id.xml share/metainfo/$id.metainfo.xml \
            share/icons/hicolor/48x48/apps/$id.png share/icons/hicolor/scalable/apps/$id.svg \
            share/man/man1/quillmark.1.gz share/man/man1/quillmark-cli.1.gz \
            share/quillmark/translations/quillmark_de.qm; do
    [ -f "$usr/$file" ] || { echo "not installed: $file"; exit 1; }
done

# Compressed as Debian wants: best compression, no file name, no time stamp.
for file in share/man/man1/quillmark.1.gz share/man/man1/quillmark-cli.1.gz; do
    [ "$(od -An -tx1 -N9 "$usr/$file" | tr -d ' \n')" = 1f8b08000000000002 ] || { echo "not gzip -9n: $file"; exit 1; }
done
# Each page names its own program; the tool's page has every subcommand's options.
zcat "$usr/share/man/man1/quillmark.1.gz" | grep -A1 '^\.SH NAME' | grep -q '^quillmark \\- edit'
zcat "$usr/share/man/man1/quillmark-cli.1.gz" | grep -A1 '^\.SH NAME' | grep -q '^quillmark-cli \\- check'
for option in fields print check save '\-\-json' '\-\-tracker' '\-\-fix' '\-\-no\-backup' '\-\-no\-length\-limit' '\-j,\-\-jobs'; do
    zcat "$usr/share/man/man1/quillmark-cli.1.gz" | grep -qF -- "$option" || { echo "man page lacks: $option"; exit 1; }
done
desktop="$usr/share/applications/$id.desktop"
grep -q '^Exec=quillmark %f$' "$desktop"
grep -q '^MimeType=application/x-ldraw;$' "$desktop"
grep -q "^Icon=$id$" "$desktop"

cli="$usr/bin/quillmark-cli"
# The command-line tool, packaged alone for machines without a desktop, needs Qt's core only.
if readelf --dynamic "$cli" | grep -Eq 'Shared library: \[libQt6(Gui|Widgets|OpenGL|DBus)'; then
    echo "quillmark-cli links a Qt GUI library"; exit 1
fi
HOME="$home" XDG_DATA_HOME= "$cli" --version | grep -q '^quillmark-cli '
HOME="$home" "$usr/bin/quillmark" --version | grep -q '^quillmark '
if [ -n "$corpus" ] && [ -d "$corpus" ]; then
    part="$corpus/parts/003432a.dat"
    status=0
    HOME="$home" XDG_DATA_HOME= "$cli" check --tracker --quiet "$part" >"$home/out.txt" || status=$?
    [ "$status" -le 1 ] || { echo "check failed with $status"; cat "$home/out.txt"; exit 1; }
    grep -q "$part" "$home/out.txt"
    # The installed defaults were copied for the user; they themselves stay as installed.
    cmp "$home/.local/share/Quillmark/category.txt" "$usr/share/quillmark/category.txt"
fi

"$(dirname "$0")/check-file-types.sh" "$usr/share/mime/packages/$id.xml" "$corpus"
"$(dirname "$0")/check-window-identity.sh" "$usr/bin/quillmark" "$desktop"

if command -v desktop-file-validate >/dev/null; then desktop-file-validate "$desktop"; fi
if command -v xmllint >/dev/null; then xmllint --noout "$usr/share/mime/packages/$id.xml" "$usr/share/metainfo/$id.metainfo.xml"; fi
if command -v appstreamcli >/dev/null; then
    appstreamcli validate --no-net --pedantic "$usr/share/metainfo/$id.metainfo.xml" >/dev/null
fi
echo "installed layout, programs and desktop files are in order"
