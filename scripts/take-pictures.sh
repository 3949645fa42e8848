#!/usr/bin/env bash
# Takes the pictures of docs/pictures: every page of the gallery at 96 and 144 dots per inch, and of the wizard of
# products/wizard97. Needs the build of the preset windows, Wine, Xvfb and ImageMagick.
set -euo pipefail
cd "$(dirname "$0")/.."
pictures=docs/pictures
rm -rf $pictures
take() { # take NAME DPI FOLDER
  scripts/preview.sh "products/$1/$1.txt" --dpi "$2" --picture "$pictures/$3" 2>/dev/null | grep -c '^picture'
  mogrify -strip -define png:exclude-chunks=date,time -define png:compression-level=9 "$pictures/$3"/*.png
}
take gallery 96 gallery-96
take gallery 144 gallery-144
take wizard97 96 wizard97-96
take wizard97 144 wizard97-144
du -sh $pictures
