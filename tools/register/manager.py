"""What the object managers have in common: how the provider is put into one, taken from it and looked for."""

import hashlib
import os
import re
from pathlib import Path

from owner import Failure, Owner, match

OLDEST_SCHEMA = "2.22"
NEWEST_CLASS = "CIM_TimeService"  # came with that CIM schema; the others are older


def digest(*texts):
    return hashlib.sha256("".join(texts).encode()).hexdigest()


class Manager(Owner):
    """One object manager. NAME, TITLE, PROGRAMS (the first three make it one) and WHAT is registered are its own."""

    found = served = False

    def __init__(self, options):
        super().__init__(options)
        self.command = {}
        mof, self.registration = (Path(file).read_text(encoding="utf-8") for file in self.product.files[:2])
        self.checksum, self.noted = digest(mof, self.registration), self.notes()
        self.ours = {name: text for text, name in re.findall(r"^(\[.*?^class (\w+).*?^\};)", mof, re.M | re.S)}
        home = os.path.dirname(os.path.dirname(self.noted.get("library-link", "")))  # an older version noted no more
        self.directories = self.noted.get("directories", f"{home}/sbin:{home}/bin" if home else "").split(":")

    def find(self):
        """Whether it is there, with every command that makes it one."""
        self.command = {name: self.locate(name, filter(None, self.directories)) for name in self.programs}
        return all(self.command[name] for name in self.programs[:3])

    def ask(self, program, *words):
        return self.call(self.command[program], *words) if self.command[program] else (127, "")

    def run(self, program, *words, **more):
        super().run(self.command.get(program) or program, *words, **more)

    def run_at_last(self, *command, **more):
        """A failure here does not hide why the rest failed."""
        try:
            self.run(*command, **more)
        except Failure as failure:
            self.fail(failure)

    def link(self):
        """Where the server looks for the library: in the named directory, one that was named before, or its own."""
        named = self.options.provider_dir or self.noted.get("provider-dir")
        directory = named or next(filter(os.path.isdir, self.looks_in()), None)
        return f"{directory}/{self.product.link_name}" if directory else None

    def require(self, link, newest, said=""):
        """What has to be there before anything is changed. NEWEST: the newest class as the server's schema has it."""
        if not link:
            raise Failure("its directory of provider libraries is not found; name it with --provider-dir")
        version = OLDEST_SCHEMA if newest is None else match(r'Version *\( *"([0-9.]+)"', newest) or "0"
        if [int(part) for part in version.split(".")] < [int(part) for part in OLDEST_SCHEMA.split(".")]:
            needed = f"{OLDEST_SCHEMA} or later is needed, which has {NEWEST_CLASS}"
            raise Failure(f"the server's CIM schema is too old: {needed}", said)

    def lacks(self, missing, same):
        if missing:
            return f"without the classes {', '.join(missing)} in {self.product.namespace}"
        return "" if same else "with other classes than those installed"

    def library(self):
        """Differs between one installation of the libraries and the next; any of them can be the one that is new."""
        stats = map(os.stat, self.product.libraries)
        return " ".join(f"{file.st_ino}/{file.st_size}/{file.st_mtime_ns}" for file in stats)

    def is_registered(self):
        return self.flaw() is not None

    def install(self):
        with self.reached():
            link, replaced = self.link(), None
            self.prepare(link)
            before = self.is_registered()
            directories = ":".join(dict.fromkeys(os.path.dirname(file) for file in self.command.values() if file))
            self.note(home=self.home, directories=directories, provider_dir=self.options.provider_dir, library_link=link)
            try:
                if link:
                    replaced = self.put_link(link, self.product.library)
                shown = self.register()
            except BaseException:
                # What was registered before still needs its link; otherwise none is needed.
                if not before and not self.is_registered():
                    self.forget()
                elif replaced:
                    self.put_link(link, replaced)
                raise
            self.note(shown=shown, library=self.library())

    def remove(self):
        link = self.link() or self.noted.get("library-link")
        if not self.is_there():
            self.say(f"{self.what} is not registered")
        else:
            try:
                self.unregister()
            except Failure as failure:
                raise Failure(f"{failure}\nThe provider stays registered. {self.by_hand()}; rm -f {link}") from failure
        self.forget(link)

    def status(self, running="", known="registered"):
        """RUNNING: whether the server does; KNOWN: how surely the provider is registered, if it is."""
        link, flaw = self.link() or self.noted.get("library-link"), self.flaw()
        known = "not registered" if flaw is None else known
        if flaw is not None and os.path.realpath(link or "/") != os.path.realpath(self.product.library):
            flaw = f"{link or 'no link'} does not lead to the library"
        if flaw and ":" not in flaw:
            flaw += ": run vk-provider-register install"
        found = f"found ({self.command[self.programs[0]]}){running}; {self.what}"
        self.say(f"{found} is {known}{f', but {flaw}' if flaw else ''}")
        return flaw == ""
