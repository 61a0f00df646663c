# shellcheck shell=sh
# Puts back the time zone that the provider replaced when daylight saving was switched off or an offset was set. What was
# there before is kept in the directory former-zone: /etc/localtime as the very link or file, or an empty file
# no-localtime where there was none, and /etc/timezone. There is no per cent sign in here: rpm would take that for one of
# its macros.

# take_first_version FILE: version 1.0.0 kept both in one file: the line "vk-zone 1", then for each of the two a line
# "absent 0", "link LENGTH" or "file LENGTH", that many bytes and a line end. Makes the directory of it.
take_first_version() {
    [ "$(head -n 1 "$1")" = "vk-zone 1" ] && mkdir "$kept" || return 1
    start=11
    for name in localtime timezone; do
        line=$(tail -c "+$start" "$1" | head -n 1)
        length=${line#* }
        case $length in "" | *[!0-9]*) return 1 ;; esac
        start=$((start + ${#line} + 1))
        case $line in
        "link "*) ln -s "$(tail -c "+$start" "$1" | head -c "$length")" "$kept/$name" || return 1 ;;
        "file "*) tail -c "+$start" "$1" | head -c "$length" >"$kept/$name" || return 1 ;;
        "absent 0") : >"$kept/no-$name" ;;
        *) return 1 ;;
        esac
        start=$((start + length + 1))
    done
    [ "$(wc -c <"$1")" -eq $((start - 1)) ]
}

# put_zone_file NAME [START]: replaces a file of /etc by the kept one at one stroke, if it begins so or leads to what
# does.
put_zone_file() {
    fresh=$etc/.$1.vk-new
    rm -f "$fresh"
    if cp -a "$kept/$1" "$fresh" 2>/dev/null && [ "$(head -c "${#2}" "$fresh" 2>/dev/null)" = "$2" ] &&
        mv -fT "$fresh" "$etc/$1"; then
        return 0
    fi
    rm -f "$fresh"
    return 1
}

# bring_zone_back [ROOT]
bring_zone_back() {
    etc=${1:-}/etc
    kept=${1:-}/var/lib/vk/instrumentation/former-zone
    older=${1:-}/var/lib/vk/instrumentation/replaced-zone
    if [ ! -e "$kept" ]; then
        [ -f "$older" ] || return 0
        take_first_version "$older" || rm -rf "$kept"
    fi
    # A link to anything but a zone of one offset is none of the provider's: an administrator chose another zone since.
    case $(readlink "$etc/localtime") in
    "" | *zoneinfo/Etc/GMT*) ;;
    *)
        rm -rf "$kept" "$older"
        return 0
        ;;
    esac
    if [ -e "$kept/no-localtime" ]; then
        rm -f "$etc/localtime"
    elif ! put_zone_file localtime TZif; then
        echo "The time zone that was replaced cannot be brought back; it stays as it is." >&2
        return 0
    fi
    if [ -f "$etc/timezone" ] && [ -e "$kept/timezone" ]; then put_zone_file timezone "" || :; fi
    rm -rf "$kept" "$older"
}

# forget_provider [ROOT]: removes what the provider kept.
forget_provider() {
    rm -rf "${1:-}/var/lib/vk/instrumentation" "${1:-}/var/lib/vk/registration" "${1:-}/run/vk-cimconfig.lock"
    rmdir "${1:-}/var/lib/vk" 2>/dev/null || :
}
