# shellcheck shell=sh
# What the host's NTP daemons are known by. Sourced by those that lie beside this file, with their directory in OURS.

export LC_ALL=C PATH="${PATH:+$PATH:}/usr/sbin:/usr/bin:/sbin:/bin"

# real_ntpd: the first ntpd in PATH that is not the wrapper.
real_ntpd() (
    IFS=:
    for directory in $PATH; do
        file=$directory/ntpd
        if [ -f "$file" ] && [ -x "$file" ] && [ "$(readlink -f "$file")" != "$OURS/ntpd" ]; then
            echo "$file"
            break
        fi
    done
)

# kind_of NTPD: ntpsec and openntpd say something else than the time service expects of -xgq; "expected" is any other.
kind_of() {
    case $([ -z "$1" ] || timeout 5 "$1" --version 2>&1 </dev/null) in
    "") [ -z "$1" ] || echo expected ;;
    *ntpsec*) echo ntpsec ;;
    *"usage: ntpd [-"*) echo openntpd ;; # knows no --version
    *) echo expected ;;
    esac
}

under_systemd() { [ -d /run/systemd/system ]; }
chronyd_runs() { chronyc -c tracking; } >/dev/null 2>&1
timesyncd_runs() { under_systemd && systemctl -q is-active systemd-timesyncd; }
