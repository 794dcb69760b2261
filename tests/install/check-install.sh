#!/usr/bin/env bash
# Installs a build into a temporary folder as a package would, checks the layout, runs the
# installed quillmark-cli as a user with an empty home, and validates the desktop files with the
# freedesktop tools where they are installed.
set -euo pipefail
build_dir="$1"
corpus_file="${2:-}"
dest="$(mktemp -d)"
home="$(mktemp -d)"
trap 'rm -rf "$dest" "$home"' EXIT
DESTDIR="$dest" cmake --install "$build_dir" --prefix /usr >/dev/null
usr="$dest/usr"
id=io.github.quillmark.Quillmark
for file in bin/quillmark bin/quillmark-cli \
            share/quillmark/category.txt share/quillmark/parttype.txt share/quillmark/bfc.txt share/quillmark/licenses.txt share/quillmark/colourcodes.txt \
            share/applications/$id.desktop share/mime/packages/$id.xml share/metainfo/$id.metainfo.xml \
            share/icons/hicolor/48x48/apps/$id.png share/man/man1/quillmark.1 share/man/man1/quillmark-cli.1; do
    [ -f "$usr/$file" ] || { echo "not installed: $file"; exit 1; }
done
grep -q '^Exec=quillmark %f$' "$usr/share/applications/$id.desktop"
grep -q '^MimeType=application/x-ldraw;$' "$usr/share/applications/$id.desktop"

cli="$usr/bin/quillmark-cli"
HOME="$home" XDG_DATA_HOME= "$cli" --version | grep -q '^quillmark-cli '
HOME="$home" "$usr/bin/quillmark" --version | grep -q '^quillmark '
if [ -n "$corpus_file" ] && [ -f "$corpus_file" ]; then
    status=0
    HOME="$home" XDG_DATA_HOME= "$cli" check --tracker --quiet "$corpus_file" >"$home/out.txt" || status=$?
    [ "$status" -le 1 ] || { echo "check failed with $status"; cat "$home/out.txt"; exit 1; }
    grep -q "$corpus_file" "$home/out.txt"
    # The installed defaults were copied for the user; they themselves stay as installed.
    cmp "$home/.local/share/Quillmark/category.txt" "$usr/share/quillmark/category.txt"
fi

if command -v desktop-file-validate >/dev/null; then desktop-file-validate "$usr/share/applications/$id.desktop"; fi
if command -v xmllint >/dev/null; then xmllint --noout "$usr/share/mime/packages/$id.xml" "$usr/share/metainfo/$id.metainfo.xml"; fi
if command -v appstreamcli >/dev/null; then appstreamcli validate --no-net "$usr/share/metainfo/$id.metainfo.xml" >/dev/null; fi
echo "installed layout, programs and desktop files are in order"
