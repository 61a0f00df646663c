# Fresh roots of releases of Debian and Ubuntu, for what is to be tried as on somebody else's machine.
# Sourced by bash, with `set -o pipefail`; needs root and debootstrap.
# shellcheck shell=bash

# Ubuntu's archive is signed with this key.
ubuntu_key=F6ECB3762474EDA9D21B7022871920D1991BC93C

# ubuntu_keyring FILE RELEASE OPTION...: that key alone, of the package that holds it in a download that nobody has checked.
# The packages are checked when the root is made of them with this keyring.
ubuntu_keyring() {
    local keyring=$1 release=$2 unchecked=$1.unchecked
    shift 2
    debootstrap --no-check-gpg --download-only "$@" "$release" "$unchecked" "" gutsy &&
        dpkg-deb -x "$unchecked"/var/cache/apt/archives/ubuntu-keyring_*.deb "$unchecked/package" &&
        gpg --batch --no-options --homedir "$unchecked/package" --no-default-keyring \
            --keyring "$unchecked/package/usr/share/keyrings/ubuntu-archive-keyring.gpg" --export "$ubuntu_key" >"$keyring" &&
        [ -s "$keyring" ] && rm -rf --one-file-system "$unchecked"
}

# debootstrap_root RELEASE DIRECTORY: Debian's from the mirror that this machine's apt uses where it is a Debian itself.
debootstrap_root() {
    local release=$1 root=$2 mirror
    local options=(--variant=minbase --cache-dir="$root.debs")
    mkdir -p "$root.debs"
    if [ "$release" = noble ]; then
        options+=("--components=main,universe")
        ubuntu_keyring "$root.gpg" "$release" "${options[@]}" &&
            # All releases of Ubuntu are made alike, also those that this debootstrap does not know yet.
            debootstrap --keyring="$root.gpg" "${options[@]}" "$release" "$root" "" gutsy || return
    else
        # shellcheck disable=SC2016 # a variable of apt-get's
        mirror=$(apt-get indextargets --format '$(SITE)' 'Created-By: Packages' 'Origin: Debian' 2>/dev/null | head -n 1)
        debootstrap "${options[@]}" "$release" "$root" "$mirror" || return
    fi
    rm -rf "$root.debs" "$root.gpg"
}

# make_root RELEASE DIRECTORY: a minimal installation. Returns non-zero where it cannot be had here; DIRECTORY.log says why.
# With VK_FRESH_ROOTS=DIRECTORY what was made is kept there, and taken from there the next time.
make_root() {
    local kept=${VK_FRESH_ROOTS:+$VK_FRESH_ROOTS/$1.tar}
    if [ -f "$kept" ]; then
        mkdir -p "$2" && tar -C "$2" -xf "$kept"
        return
    fi
    debootstrap_root "$1" "$2" >"$2.log" 2>&1 || return
    if [ -n "$kept" ]; then mkdir -p "$VK_FRESH_ROOTS" && tar -C "$2" -cf "$kept.new" . && mv "$kept.new" "$kept"; fi
}

# in_root DIRECTORY COMMAND...: in namespaces of its own, so that nothing stays mounted and nothing goes on running. The
# directory becomes the root of all mounts: after a mere chroot nobody there could make namespaces.
in_root() {
    # shellcheck disable=SC2016 # variables of the inner shell
    unshare --mount --pid --fork --kill-child sh -c '
        cd "$1" && mount --bind . . && cd "$1" && shift &&
            mount -t proc proc proc && mount -t devpts -o newinstance,ptmxmode=0666 devpts dev/pts &&
            pivot_root . mnt && cd / && umount -l /mnt || exit
        exec /usr/bin/env -i PATH=/usr/sbin:/usr/bin:/sbin:/bin LC_ALL=C HOME=/root "$@"' in_root "$@"
}
