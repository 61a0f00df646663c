"""The link to the command that reads and changes the object manager's settings, where the provider looks for it."""

import contextlib
import os
import re


def is_kvm(root):
    """The provider asks the processor and the firmware; the kernel's clock for KVM guests stands for the processor here."""
    signs = {"devices/system/clocksource/clocksource0/available_clocksource": r"\bkvm-clock\b",
             "class/dmi/id/product_name": "^KVM", "class/dmi/id/sys_vendor": "^QEMU"}
    for file, sign in signs.items():
        with contextlib.suppress(OSError), open(f"{root}/sys/{file}", encoding="utf-8", errors="replace") as text:
            if re.search(sign, text.read(), re.M):
                return True
    return False


def can_run(root, path):
    """A link counts by where it leads below the root."""
    for _ in range(40):  # as many as the kernel follows
        if not os.path.islink(path):
            break
        there = os.readlink(path)
        path = root + there if there.startswith("/") else os.path.join(os.path.dirname(path), there)
    return os.path.isfile(path) and os.access(path, os.X_OK)


def put(host, folders):
    place = f"{host.root}{'/usr/sbin' if is_kvm(host.root) else host.product.command_folder}/cimconfig"
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
