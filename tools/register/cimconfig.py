"""The link to the command that reads and changes the object manager's settings, where the provider looks for it."""

import contextlib
import ctypes
import os

from owner import Owner


class Cimconfig(Owner):
    name = title = "cimconfig"

    def is_kvm(self):
        """The provider's own answer. The first library is there for the second, wherever both were installed."""
        _, library = (ctypes.CDLL(f"{self.product.libdir}/lib{name}.so.1") for name in ("nvlog", "vkcommon"))
        return library.vkIsKvmGuest(os.fsencode(self.root or "/")) == 1

    def can_run(self, path):
        """A link counts by where it leads below the root."""
        for _ in range(40):  # as many as the kernel follows
            if os.path.islink(path):
                there = os.readlink(path)
                path = self.root + there if there.startswith("/") else os.path.join(os.path.dirname(path), there)
        return os.path.isfile(path) and os.access(path, os.X_OK)

    def install(self, directories):
        directory = f"{self.root}{'/usr/sbin' if self.is_kvm() else self.product.command_directory}"
        place, found = f"{directory}/cimconfig", self.locate("cimconfig", directories, but_not=os.path.realpath(directory))
        if not self.is_ours(place) and self.can_run(place):
            self.say(f"{place} is there already")
        elif found:
            self.put_link(place, found[len(self.root):])
        elif self.can_run(place):
            self.say(f"{place} links to {os.readlink(place)} already")
        else:
            self.say("not found; VESKA_CIMServiceConfig will show 0 for its settings")

    def remove(self):
        directory = f"{self.root}{self.product.command_directory}"
        made = any(line.startswith(f"{directory}/cimconfig -> ") for line in self.read(".links"))
        self.forget(f"{directory}/cimconfig")
        if made and not self.options.dry_run:
            with contextlib.suppress(OSError):
                for way in (".", "..", "../.."):
                    os.rmdir(os.path.normpath(f"{directory}/{way}"))
