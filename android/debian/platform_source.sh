#!/usr/bin/env bash
# platform_source.sh PACKAGE MEGABYTES FOLDER PATTERN...: downloads a Debian source package and extracts the files that
# match the patterns into FOLDER. The machine's apt configuration does not change.
set -euo pipefail
package=$1
megabytes=$2
folder=$PWD/$3
shift 3
rm -rf "$folder"
mkdir -p "$folder"/{apt,parts,lists}

for sources in /etc/apt/sources.list /etc/apt/sources.list.d/*.{list,sources}; do
    [ ! -f "$sources" ] || sed -E 's/^deb /deb-src /; s/^(Types:).*/\1 deb-src/' "$sources" >"$folder/parts/${sources##*/}"
done
apt=(apt-get -qq -o Dir::Etc::SourceList=/dev/null -o Dir::Etc::SourceParts="$folder/parts"
    -o Dir::State::Lists="$folder/lists" -o Dir::Cache="$folder/apt" -o APT::Sandbox::User=)
"${apt[@]}" update
echo "Going to download the source package $package ($megabytes MB) with apt-get"
(cd "$folder" && "${apt[@]}" source --download-only "$package")
tar -x --wildcards -f "$folder/$package"_*.orig.tar.* -C "$folder" "$@"
rm -rf "$folder"/{apt,parts,lists,"$package"_*}
