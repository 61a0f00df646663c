"""The link to the command that reads and changes the object manager's settings, where the provider looks for it."""

import contextlib
import ctypes
import os


def is_kvm(host):
    """The provider's own answer. The first library is there for the second, wherever both were installed."""
    _, library = (ctypes.CDLL(f"{host.product.libdir}/lib{name}.so.1") for name in ("nvlog", "vkcommon"))
    return library.vkIsKvmGuest(os.fsencode(host.root or "/")) == 1


def can_run(root, path):
    """A link counts by where it leads below the root."""
    for _ in range(40):  # as many as the kernel follows
        if not os.path.islink(path):
            break
        there = os.readlink(path)
        path = root + there if there.startswith("/") else os.path.join(os.path.dirname(path), there)
    return os.path.isfile(path) and os.access(path, os.X_OK)


def put(host, folders):
    place = f"{host.root}{'/usr/sbin' if is_kvm(host) else host.product.command_folder}/cimconfig"
    ours, found = host.is_ours("cimconfig", place), host.find("cimconfig", folders, but_not=os.path.realpath(os.path.dirname(place)))
    if not ours and can_run(host.root, place):
        host.say(f"{place} is there already")
    elif found:
        host.put_link("cimconfig", place, found[len(host.root):])
    elif can_run(host.root, place):
        host.say(f"{place} links to {os.readlink(place)} already")
    else:
        host.say("not found; VESKA_CIMServiceConfig will show 0 for its settings")


def take(host):
    usual = f"{host.root}{host.product.command_folder}/cimconfig"
    made = any(line.startswith(f"{usual} -> ") for line in host.made_links("cimconfig"))
    host.take_links("cimconfig", usual)
    if made and not host.dry_run:
        with contextlib.suppress(OSError):
            for folder in (".", "..", "../.."):
                os.rmdir(os.path.normpath(f"{host.root}{host.product.command_folder}/{folder}"))
