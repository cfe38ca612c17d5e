# shellcheck shell=bash
# Reading the updater's screen the way a person looks at it: from a
# screenshot of display :0. The updater's look is fixed by its style: a
# title bar in the primary blue, message boxes with a blue information or an
# orange warning icon, and grey buttons (NO on the left, YES on the right, or
# one CLOSE across the row). Nothing here knows the button texts, so every
# language reads alike.

TITLE_BAR_RGB="23 70 143"
BUTTON_COLOUR='#D6D7D7'
INFO_ICON_COLOUR='#0061A7'
WARNING_ICON_COLOUR='#FF7043'
# A button is a grey area far larger than any grey in a letter or an icon.
BUTTON_MIN_AREA=1500
# Share of the screen an icon colour needs before the icon counts as shown.
ICON_MIN_SHARE=0.004

export DISPLAY=:0
export XAUTHORITY=/home/x_user/.Xauthority

take_screenshot() {
    import -silent -window root "$1" 2>/dev/null
}

# Marks the pixels of colour $1 white and all others black.
mask_of() {
    printf '%s\n' -fill '#FF00FF' -opaque "$1" -fill black +opaque '#FF00FF' -fill white -opaque '#FF00FF'
}

# Reads screenshot $1 in one pass. Prints "title R G B" (a pixel of the
# title bar), "info SHARE" and "warning SHARE" (how much of the screen has
# each icon's colour) and "button LEFT TOP WIDTH HEIGHT" for each button.
read_screen() {
    local info_mask warning_mask button_mask
    mapfile -t info_mask < <(mask_of "$INFO_ICON_COLOUR")
    mapfile -t warning_mask < <(mask_of "$WARNING_ICON_COLOUR")
    mapfile -t button_mask < <(mask_of "$BUTTON_COLOUR")
    convert "$1" -alpha off -format 'title %[pixel:p{4,4}]\n' -write info: \
        \( +clone -fuzz 6% "${info_mask[@]}" -colorspace gray -format 'info %[fx:mean]\n' -write info: +delete \) \
        \( +clone -fuzz 6% "${warning_mask[@]}" -colorspace gray -format 'warning %[fx:mean]\n' -write info: +delete \) \
        -fuzz 3% "${button_mask[@]}" -define connected-components:verbose=true \
        -define "connected-components:area-threshold=$BUTTON_MIN_AREA" -connected-components 8 null: |
        awk '
            $1 == "title" { gsub(/[^0-9,]/, "", $2); split($2, rgb, ","); print "title", rgb[1], rgb[2], rgb[3]; next }
            $1 == "info" || $1 == "warning" { print; next }
            $1 ~ /^[0-9]+:$/ && $NF ~ /255/ { split($2, box, /[x+]/); print "button", box[3], box[4], box[1], box[2] }
        ' | sort -k1,1 -k2,2n
}

# Prints "left top width height" of each button on screenshot $1, left to right.
buttons_in() {
    read_screen "$1" | awk '$1 == "button" { print $2, $3, $4, $5 }'
}

# What the screenshot $1 shows: "none" (no updater window), "page" (a
# progress page), "box-ICON-BUTTONS" (a message box, e.g. box-info-2), or
# "settling" (a box still being drawn).
screen_state() {
    read_screen "$1" | awk -v title="$TITLE_BAR_RGB" -v icon_share="$ICON_MIN_SHARE" '
        function near(a, b) { return a - b < 12 && b - a < 12 }
        $1 == "title" { split(title, want, " "); shown = near($2, want[1]) && near($3, want[2]) && near($4, want[3]) }
        $1 == "info" && $2 > icon_share { icon = "info" }
        $1 == "warning" && $2 > icon_share { icon = "warning" }
        $1 == "button" { buttons++ }
        END {
            if (!shown) print "none"
            else if (icon == "" && buttons == 0) print "page"
            else if (icon == "" || buttons == 0) print "settling"
            else print "box-" icon "-" buttons
        }'
}

# Presses the button at position $2 ("left" or "right") on screenshot $1:
# a real pointer click in its middle, then the pointer moves off the buttons.
press_button() {
    local shot=$1 side=$2 left top width height
    if [[ $side == left ]]; then
        read -r left top width height < <(buttons_in "$shot" | head -n 1)
    else
        read -r left top width height < <(buttons_in "$shot" | tail -n 1)
    fi
    [[ -n ${height:-} ]] || return 1
    xdotool mousemove --sync $((left + width / 2)) $((top + height / 2)) click 1
    sleep 0.2
    xdotool mousemove 1 1
}
