# shellcheck shell=sh
# Puts back the time zone that the provider replaced when daylight saving was switched off or an offset was set. What was
# there before is kept in one file: the line "vk-zone 1", then for /etc/localtime and for /etc/timezone a line "absent 0",
# "link LENGTH" or "file LENGTH", that many bytes, and a line end. A file that is not of that form is left alone.
# There is no per cent sign in it: rpm would take that for one of its macros.

# zone_entry NUMBER: sets kind, length and start (the first byte, counted from 1) of the first or second entry.
zone_entry() {
    start=11
    entry=1
    while :; do
        line=$(tail -c "+$start" "$kept" | head -n 1)
        case $line in
        "absent "*) kind="absent" ;;
        "link "*) kind="link" ;;
        "file "*) kind="file" ;;
        *) return 1 ;;
        esac
        length=${line#* }
        case $length in "" | *[!0-9]*) return 1 ;; esac
        start=$((start + ${#line} + 1))
        [ "$entry" -lt "$1" ] || return 0
        start=$((start + length + 1))
        entry=$((entry + 1))
    done
}

zone_bytes() { tail -c "+$start" "$kept" | head -c "$length"; }

# put_zone_entry FILE: replaces FILE at one stroke by what zone_entry found; a link only where it leads somewhere.
put_zone_entry() {
    case $kind in
    link)
        ln -sfn "$(zone_bytes)" "$1.vk-new" || return 1
        if [ ! -e "$1.vk-new" ]; then
            rm -f "$1.vk-new"
            return 1
        fi
        ;;
    file)
        if ! zone_bytes >"$1.vk-new" || [ "$(wc -c <"$1.vk-new")" -ne "$length" ]; then
            rm -f "$1.vk-new"
            return 1
        fi
        chmod 644 "$1.vk-new"
        ;;
    absent)
        rm -f "$1"
        return
        ;;
    esac
    mv -fT "$1.vk-new" "$1"
}

# bring_zone_back [ROOT]
bring_zone_back() {
    kept=${1:-}/var/lib/vk/instrumentation/replaced-zone
    [ -f "$kept" ] || return 0
    if [ "$(head -n 1 "$kept")" != "vk-zone 1" ] || ! zone_entry 1 || ! put_zone_entry "${1:-}/etc/localtime"; then
        echo "The time zone that was replaced cannot be brought back; it stays as it is." >&2
        return 0
    fi
    if [ -e "${1:-}/etc/timezone" ] && zone_entry 2 && [ "$kind" != absent ]; then
        put_zone_entry "${1:-}/etc/timezone" || :
    fi
    rm -f "$kept"
}

# forget_provider [ROOT]: removes what the provider kept.
forget_provider() {
    rm -rf "${1:-}/var/lib/vk/instrumentation" "${1:-}/var/lib/vk/registration"
    rmdir "${1:-}/var/lib/vk" 2>/dev/null || :
}
