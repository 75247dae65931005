#!/usr/bin/env bash
# Draws the host's compiled-in icons and the plug-in's tab image.
#
# Every icon is described as ImageMagick MVG on a small design grid, drawn
# 8x oversized and box-filtered down, so edges come out anti-aliased and the
# output is the same on every run. Re-run after editing a drawing:
#
#     scripts/make_icons.sh
#
# Needs ImageMagick's convert (set CONVERT to use another binary).
set -euo pipefail

CONVERT=${CONVERT:-convert}
ROOT=$(cd "$(dirname "${BASH_SOURCE[0]}")/.." && pwd)
HERE="$ROOT/host/resources"
SS=8                      # oversampling factor

# Palette
INK='#37474F'             # dark blue-grey strokes
BLUE='#1E88E5'            # accent / "blue line" icons
PALE='#E3F2FD'            # light blue fill
LIGHT='#ECEFF1'           # light grey fill
MID='#90A4AE'             # mid grey details
AMBER='#FFCA28'
RED='#E53935'
GREEN='#43A047'

FONT_BOLD=DejaVu-Sans-Bold
if ! "$CONVERT" -list font 2>/dev/null | grep -q "Font: $FONT_BOLD\$"; then
    FONT_BOLD=$(fc-match -f '%{file}' 'DejaVu Sans:bold' 2>/dev/null || echo Helvetica-Bold)
fi

# icon OUT SIZE GRID MVG
#   OUT  path relative to host/resources (or absolute)
#   SIZE output edge length in pixels
#   GRID edge length of the design grid the MVG coordinates refer to
icon() {
    local out=$1 size=$2 grid=$3 mvg=$4
    [[ $out = /* ]] || out="$HERE/$out"
    mkdir -p "$(dirname "$out")"
    local big=$((size * SS))
    local k
    k=$(awk -v b="$big" -v g="$grid" 'BEGIN { printf "%.6f", b / g }')
    "$CONVERT" -size "${big}x${big}" xc:none \
        -draw "affine $k,0,0,$k,0,0 stroke-linecap round stroke-linejoin round $mvg" \
        -scale "${size}x${size}" -strip "PNG32:$out"
}

# gear CX CY R_OUT R_IN TEETH -> MVG polygon point list of a toothed wheel
gear() {
    awk -v cx="$1" -v cy="$2" -v ro="$3" -v ri="$4" -v n="$5" 'BEGIN {
        pi = atan2(0, -1); step = 2 * pi / n; pts = ""
        for (i = 0; i < n; i++) {
            a = i * step - pi / 2
            # root, flank up, tip, tip, flank down
            split(sprintf("%f %f %f %f", a - step * 0.30, a - step * 0.17, a + step * 0.17, a + step * 0.30), t, " ")
            pts = pts sprintf(" %.2f,%.2f", cx + ri * cos(t[1]), cy + ri * sin(t[1]))
            pts = pts sprintf(" %.2f,%.2f", cx + ro * cos(t[2]), cy + ro * sin(t[2]))
            pts = pts sprintf(" %.2f,%.2f", cx + ro * cos(t[3]), cy + ro * sin(t[3]))
            pts = pts sprintf(" %.2f,%.2f", cx + ri * cos(t[4]), cy + ri * sin(t[4]))
        }
        print pts
    }'
}

# ---------------------------------------------------------------- shared shapes
# (all on a 32 grid)

PLUS_BL="stroke $BLUE stroke-width 3.5 fill none line 16,6 16,26 line 6,16 26,16"
MINUS_BL="stroke $BLUE stroke-width 3.5 fill none line 6,16 26,16"

TRASH_BL="stroke $BLUE stroke-width 2.4 fill none
    line 5,8 27,8
    polyline 12,8 12,4.5 20,4.5 20,8
    path 'M 8,8 L 9.8,28 L 22.2,28 L 24,8'
    line 13,12.5 13,23.5 line 16,12.5 16,23.5 line 19,12.5 19,23.5"

GEAR_BL="stroke $BLUE stroke-width 2.2 fill none
    polygon $(gear 16 16 13.5 9.5 8)
    circle 16,16 16,20"

MAGNIFIER_BL="stroke $BLUE fill none
    stroke-width 2.6 circle 13,13 13,22.5
    stroke-width 4.5 line 20.5,20.5 27.5,27.5"

# a blue disc with a white plus, bottom right, for "add ..." actions
PLUS_BADGE="stroke white stroke-width 1.5 fill $BLUE circle 24,24 24,31.5
    stroke white stroke-width 2.6 fill none line 24,19.5 24,28.5 line 19.5,24 28.5,24"

# ---------------------------------------------------------------- application

icon Images/AppIcon-QCTemplate.png 64 64 "
    stroke $INK stroke-width 3.5 fill $LIGHT roundrectangle 11,9 53,59 5,5
    stroke none fill white rectangle 17,18 47,53
    stroke $INK stroke-width 2 fill $MID roundrectangle 22,4 42,15 3,3
    stroke none fill $INK circle 32,7.5 32,9
    stroke $BLUE stroke-width 7 fill none polyline 20,35 29,44 45,25"

# ---------------------------------------------------------------- tool bar (24 px)

icon NewTemplate.png 24 32 "
    stroke $INK stroke-width 2 fill white path 'M 6,3 L 18,3 L 25,10 L 25,29 L 6,29 Z'
    fill none polyline 18,3 18,10 25,10
    stroke $MID stroke-width 1.6 line 10,15 20,15 line 10,19 16,19
    $PLUS_BADGE"

icon OpenTemplate.png 24 32 "
    stroke $INK stroke-width 2 fill $AMBER path 'M 3,7 L 11,7 L 14,10 L 26,10 L 26,27 L 3,27 Z'
    fill '#FFE082' path 'M 3,27 L 8,15 L 30,15 L 26,27 Z'"

icon SaveTemplate.png 24 32 "
    stroke $INK stroke-width 2 fill $BLUE path 'M 4,4 L 24,4 L 28,8 L 28,28 L 4,28 Z'
    fill $LIGHT rectangle 9,4 22,12
    stroke none fill $INK rectangle 17,5.5 20,10.5
    stroke $INK stroke-width 1.5 fill white rectangle 8,17 24,28
    stroke $MID stroke-width 1.4 line 11,21 21,21 line 11,24.5 21,24.5"

# ---------------------------------------------------------------- editor actions (32 px)

icon AddSchematic.png 32 32 "
    stroke $INK stroke-width 2 fill white rectangle 3,5 25,24
    stroke none fill $AMBER circle 18.5,10.5 18.5,13
    fill $MID polygon 4,23 10.5,14 15,19.5 18,16.5 24,23
    $PLUS_BADGE"

icon Icon-Add-BL.png 32 32 "$PLUS_BL"
icon Icon-Remove-BL.png 32 32 "$MINUS_BL"
icon Icon-Trash-BL.png 32 32 "$TRASH_BL"
icon L1_Marlo_Icon_Settings_01_BL.png 32 32 "$GEAR_BL"

icon L2_SC_Icon_Delete_01_BL.png 32 32 "
    stroke $BLUE stroke-width 2.6 fill none circle 16,16 16,28
    stroke-width 3 line 11.5,11.5 20.5,20.5 line 20.5,11.5 11.5,20.5"

# chain: two rounded links on a diagonal, overlapping in the middle
icon Link.png 32 32 "
    stroke $INK stroke-width 3 fill none
    push graphic-context translate 16,16 rotate -45
      roundrectangle -14,-4.5 2.5,4.5 4.5,4.5
      stroke $BLUE roundrectangle -2.5,-4.5 14,4.5 4.5,4.5
    pop graphic-context"

icon Unlink.png 32 32 "
    stroke $INK stroke-width 3 fill none
    push graphic-context translate 16,16 rotate -45
      roundrectangle -15,-4.5 -3.5,4.5 4.5,4.5
      stroke $BLUE roundrectangle 3.5,-4.5 15,4.5 4.5,4.5
      stroke $RED stroke-width 1.8
      line 0,-6.5 0,-10 line -3,-6.5 -5.5,-9.5 line 3,-6.5 5.5,-9.5
      line 0,6.5 0,10 line -3,6.5 -5.5,9.5 line 3,6.5 5.5,9.5
    pop graphic-context"

icon ObjectButtonChecked_BL.png 32 32 "
    stroke $BLUE stroke-width 2.2 fill $PALE
    polygon 9,4 9,26 14.2,21.2 18,29.5 21.8,27.8 18,19.8 25,19.8"

icon SelectButtonChecked_BL.png 32 32 "
    stroke $BLUE stroke-width 2.2 fill none stroke-linecap butt
    stroke-dasharray 3.5,2.5 rectangle 5,7 27,25
    stroke-dasharray none stroke-width 1.4 fill white
    rectangle 3,5 7,9 rectangle 25,5 29,9 rectangle 3,23 7,27 rectangle 25,23 29,27"

icon Swap.png 32 32 "
    stroke $INK stroke-width 2.6 fill none
    line 5,11 22,11 stroke none fill $INK polygon 27,11 20,5.5 20,16.5
    stroke $BLUE stroke-width 2.6 fill none
    line 27,21 10,21 stroke none fill $BLUE polygon 5,21 12,15.5 12,26.5"

icon ZoomOriginalButtonChecked_BL.png 32 32 "
    stroke $BLUE fill white stroke-width 2.2 circle 13,13 13,25
    stroke-width 4.5 line 22,22 29,29
    stroke none fill $BLUE font '$FONT_BOLD' font-size 9 text-anchor middle text 13,16.2 '1:1'"

icon arrow-down.png 32 32 "stroke $INK stroke-width 1 fill $INK polygon 8,12 24,12 16,21"
icon arrow-up.png 32 32 "stroke $INK stroke-width 1 fill $INK polygon 8,20 24,20 16,11"

# ---------------------------------------------------------------- library pane (Images/, 32 px)

icon Images/Icon-Add-BL.png 32 32 "$PLUS_BL"
icon Images/Icon-Trash-BL.png 32 32 "$TRASH_BL"
icon Images/Icon-OptionsGear-BL.png 32 32 "$GEAR_BL"
icon Images/Icon-Search-BL.png 32 32 "$MAGNIFIER_BL"

icon Images/Icon-Librar-BL.png 32 32 "
    stroke $BLUE stroke-width 2.2 fill none
    rectangle 4,6 9.5,27 line 4,10 9.5,10 line 4,23 9.5,23
    rectangle 11.5,9 17,27 line 11.5,13 17,13 line 11.5,23 17,23
    push graphic-context translate 19,27 rotate -18
      rectangle 0,-19 5.5,0 line 0,-15 5.5,-15 line 0,-4 5.5,-4
    pop graphic-context
    stroke-width 2.6 line 2,28.5 30,28.5"

icon Images/Icon-Standard-BL.png 32 32 "
    stroke none fill $RED rectangle 8,7 24,12
    fill $GREEN rectangle 8,12 24,17
    fill $BLUE rectangle 8,17 24,22
    stroke $BLUE stroke-width 2.2 fill none roundrectangle 5,3 27,29 2.5,2.5
    line 5,22 27,22
    stroke-width 1.6 line 10,25.5 22,25.5"

icon Images/Icon-Tag-BL.png 32 32 "
    stroke $BLUE stroke-width 2.4 fill none
    path 'M 4,5.5 Q 4,4 5.5,4 L 15,4 L 28,17 L 17,28 L 4,15 Z'
    circle 10,10 10,12"

# ---------------------------------------------------------------- object types (16 px tree icons)

icon Types/Folder.png 16 16 "
    stroke $INK stroke-width 1 fill $AMBER
    path 'M 1.5,3.5 L 6,3.5 L 7.5,5 L 14.5,5 L 14.5,13.5 L 1.5,13.5 Z'
    stroke none fill '#FFE082' rectangle 2,7 14,13"

icon Types/QCJobTemplate.png 16 16 "
    stroke $INK stroke-width 1 fill white roundrectangle 2.5,2.5 13.5,15 1,1
    stroke none fill $INK roundrectangle 5,1 11,4 1,1
    stroke $BLUE stroke-width 1.9 fill none polyline 4.8,9.2 7.2,11.6 11.4,6.4"

icon Types/Standard.png 16 16 "
    stroke none fill $RED rectangle 2,2 8,8
    fill $GREEN rectangle 8,2 14,8
    fill $BLUE rectangle 2,8 8,14
    fill $AMBER rectangle 8,8 14,14
    stroke $INK stroke-width 1 fill none roundrectangle 1.5,1.5 14.5,14.5 1,1"

icon Types/ColorStandardsLibrary.png 16 16 "
    stroke $INK stroke-width 1
    fill $RED rectangle 1.5,2.5 5,14
    fill $GREEN rectangle 5,4.5 8.5,14
    fill $BLUE rectangle 8.5,2.5 12,14
    fill $AMBER path 'M 12,14 L 12,4.8 L 14.9,4.2 L 15.1,14 Z'
    stroke none fill white rectangle 2.5,4 4,5 rectangle 6,6 7.5,7 rectangle 9.5,4 11,5"

icon Types/ToleranceSet.png 16 16 "
    stroke none fill $BLUE roundrectangle 1,1 15,15 2.5,2.5
    stroke white stroke-width 1.8 fill none stroke-linecap butt
    line 8,3.2 8,9.2 line 5,6.2 11,6.2 line 5,12 11,12"

icon Types/PropertyLibrary.png 16 16 "
    stroke $INK stroke-width 1 fill white rectangle 2.5,1.5 13.5,14.5
    stroke none fill $BLUE rectangle 4,4 6,6 rectangle 4,7.5 6,9.5 rectangle 4,11 6,13
    stroke $MID stroke-width 1.2 line 7.5,5 11.8,5 line 7.5,8.5 11.8,8.5 line 7.5,12 11.8,12"

icon Types/TagDefinition.png 16 16 "
    stroke $INK stroke-width 1 fill $BLUE
    path 'M 1.5,2.5 Q 1.5,1.5 2.5,1.5 L 7.5,1.5 L 14.5,8.5 L 8.5,14.5 L 1.5,7.5 Z'
    stroke none fill white circle 5,5 5,6.3"

icon Types/MeasurementConfiguration.png 16 16 "
    push graphic-context translate 8,8 rotate -45
      stroke $INK stroke-width 1 fill $AMBER rectangle -7.5,-3 7.5,3
      stroke $INK stroke-width 0.9 stroke-linecap butt
      line -5,-3 -5,0.5 line -2.5,-3 -2.5,-1 line 0,-3 0,0.5 line 2.5,-3 2.5,-1 line 5,-3 5,0.5
    pop graphic-context"

# a single tolerance: a blue bracket with plus/minus, lighter than the set's tile
icon Types/Tolerance.png 16 16 "
    stroke $BLUE stroke-width 1.2 fill $PALE roundrectangle 1.5,1.5 14.5,14.5 2.5,2.5
    stroke $BLUE stroke-width 1.6 fill none stroke-linecap butt
    line 8,3.5 8,9 line 5.2,6.2 10.8,6.2 line 5.2,11.8 10.8,11.8"

icon Types/CheckPoint.png 16 16 "
    stroke $INK stroke-width 1 fill white rectangle 1.5,1.5 14.5,14.5
    stroke $BLUE stroke-width 1.4 fill none circle 8,8 8,12.5
    stroke none fill $BLUE circle 8,8 8,9.6"

icon Types/CheckPointCouple.png 16 16 "
    stroke $INK stroke-width 1 fill white rectangle 0.5,3.5 8.5,11.5 rectangle 7.5,4.5 15.5,12.5
    stroke none fill $BLUE circle 4.5,7.5 4.5,9.3
    fill $AMBER circle 11.5,8.5 11.5,10.3"

icon Types/SchematicImage.png 16 16 "
    stroke $INK stroke-width 1 fill white rectangle 1.5,2.5 14.5,13.5
    stroke none fill $AMBER circle 10.5,5.5 10.5,7
    fill $MID polygon 2,13 6,7.5 8.5,10.5 10.5,8.5 14,13"

icon Types/ColorValue.png 16 16 "
    stroke $INK stroke-width 1 fill $LIGHT roundrectangle 1.5,1.5 14.5,14.5 1.5,1.5
    stroke none fill $RED circle 6,6.5 6,9.5
    fill $GREEN circle 10,6.5 10,9.5
    fill $BLUE circle 8,10 8,13"

# a lamp above an eye: the illuminant and observer of a colour
icon Types/ColorimetricCondition.png 16 16 "
    stroke $INK stroke-width 1 fill $AMBER circle 8,4.5 8,7.5
    fill white path 'M 1.5,11.5 Q 8,6 14.5,11.5 Q 8,17 1.5,11.5 Z'
    stroke none fill $BLUE circle 8,11.5 8,13.3"

# any object without a drawing of its own
icon Types/Object.png 16 16 "
    stroke $INK stroke-width 1 fill $LIGHT polygon 8,1.5 14.5,5 14.5,11.5 8,15 1.5,11.5 1.5,5
    fill none polyline 1.5,5 8,8.5 14.5,5 line 8,8.5 8,15"

# ---------------------------------------------------------------- plug-in tab image
# White bold "QC" on a transparent 47x52 canvas; the host paints it on a dark
# tab, so no outline or shadow. Written with Huffman-only deflate (strategy 2),
# which keeps the file at roughly 1.5 KB.

"$CONVERT" -size $((47 * SS))x$((52 * SS)) xc:none \
    -font "$FONT_BOLD" -pointsize $((22 * SS)) -fill white -stroke none \
    -gravity center -annotate +0+0 'QC' \
    -scale 47x52 -strip \
    -define png:compression-level=9 -define png:compression-strategy=2 \
    "PNG32:$ROOT/resources/images/PellamIcon.png"
