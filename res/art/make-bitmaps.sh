#!/bin/sh
# Draws the library's bitmaps from the files in this folder into the folder above. Needs ImageMagick and the URW fonts;
# run it after changing a picture and commit both.
set -eu
cd "$(dirname "$0")"
out=..

# Four times the size, then reduced: the lines of the drawing come out evenly smooth.
tmp=$(mktemp -d)
trap 'rm -rf "$tmp"' EXIT
layer() { # file, stroke colour, result
  convert -size 1328x1040 xc:none -stroke "$2" -draw "scale 4,4 $(sed '/^#/d' "$1")" -filter Box -resize 25% "$3"
}
layer splash-page.mvg none "$tmp/page.png"
layer splash-art.mvg '#A9BED2' "$tmp/art-light.png"
layer splash-art.mvg '#7FA3C4' "$tmp/art-dark.png"
layer splash-text.mvg none "$tmp/text.png"
convert -size 332x260 gradient:'#FFFFFF-#EEF2F6' \
  "$tmp/art-light.png" -composite \
  "$tmp/page.png" -composite \
  \( "$tmp/art-dark.png" -crop 332x96+0+0 +repage \) -composite \
  "$tmp/text.png" -composite \
  -alpha off -type TrueColor -depth 8 "BMP3:$out/splash.bmp"

# The image lists of the directory dialog have four bits a pixel; drives 0 to 2 have no use and repeat the fixed disk.
strip() { # result, pictures from left to right
  result=$1
  shift
  convert "$@" +append -alpha off +dither -type Palette -colors 16 "BMP3:$out/$result"
}
fixed=drive-fixed.xpm
strip drives.bmp $fixed $fixed $fixed drive-cdrom.xpm drive-removable.xpm drive-ram.xpm drive-network.xpm $fixed
strip folders.bmp folders.xpm

# One bit a pixel: the menu draws these pictures in its own colours.
for picture in float dock; do
  convert $picture.xpm -alpha off -monochrome "BMP3:$out/$picture.bmp"
done
