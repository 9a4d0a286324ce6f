#!/usr/bin/env bash
# Installs the built program into a temporary prefix and checks that the installed tree
# holds the program with its data files and that the installed program starts.
set -euo pipefail
build="$1"
source="$2"
prefix="$(mktemp -d)"
trap 'rm -rf "$prefix"' EXIT

cmake --install "$build" --prefix "$prefix" >/dev/null
program="$(readlink -f "$prefix/bin/lum")"
folder="$(dirname "$program")"
# Every file of data/ and the built game database lie beside the program.
[ -f "$folder/CRCID.dat" ] || { echo "missing beside the program: CRCID.dat"; exit 1; }
(cd "$source/data" && find . -type f ! -name CMakeLists.txt) | while read -r f; do
    [ -f "$folder/$f" ] || { echo "missing beside the program: $f"; exit 1; }
done
[ -f "$prefix/share/applications/lum.desktop" ] || { echo "missing desktop entry"; exit 1; }
desktop-file-validate "$prefix/share/applications/lum.desktop"
[ -f "$prefix/share/icons/hicolor/128x128/apps/lum.png" ] || { echo "missing icon"; exit 1; }

# Start it with both paths known (no first-run box), offscreen; it must still be running
# after a few seconds, having loaded its option set and listed the folder.
home="$prefix/home"
mkdir -p "$home/config/lum" "$home/roms"
touch "$home/roms/Game.bin"
printf '[Settings]\nZ26Path=%s\nROMPath=%s\nROMChecked=True\n' "$home" "$home/roms" \
    > "$home/config/lum/lum.ini"
XDG_CONFIG_HOME="$home/config" QT_QPA_PLATFORM=offscreen "$prefix/bin/lum" &
pid=$!
sleep 3
if ! kill -0 "$pid" 2>/dev/null; then
    wait "$pid" || true
    echo "the installed program did not keep running"
    exit 1
fi
kill "$pid"
wait "$pid" 2>/dev/null || true
# The installed program answers --version without a display.
version="$(env -u DISPLAY -u WAYLAND_DISPLAY -u QT_QPA_PLATFORM "$prefix/bin/lum" --version)"
[ "$version" = "lum $(sed -n 's/^project(lum VERSION \([0-9.]*\).*/\1/p' "$source/CMakeLists.txt")" ] \
    || { echo "lum --version said: $version"; exit 1; }
echo "installed tree OK"
