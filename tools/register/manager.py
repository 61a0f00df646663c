"""What the object managers have in common."""

import os

from host import Failure


class Manager:
    """One object manager. NAME, TITLE and PROGRAMS are its own, the first NEEDED programs make it one."""
    needed = 3

    def __init__(self, host):
        self.host, self.product, self.noted = host, host.product, host.notes(self.name)
        self.folders = [folder for folder in self.noted.get("folders", "").split(":") if folder]
        if not self.folders and "library-link" in self.noted:  # a note of an older version
            home = os.path.dirname(os.path.dirname(self.noted["library-link"]))
            self.folders = [f"{home}/sbin", f"{home}/bin"]
        self.command, self.env = {}, None

    def ask(self, program, *words):
        return self.host.call([self.command[program], *words], self.env) if self.command[program] else (127, "")

    def run(self, program, *words, done=""):
        self.host.run([self.command[program], *words], done, self.env)

    def library_link(self, folders):
        """Where the server looks for the library: in the named directory, in one that was named before, or in its own."""
        folder = self.host.provider_dir or self.noted.get("provider-dir") or next(filter(os.path.isdir, folders), None)
        return f"{folder}/{self.product.link_name}" if folder else None

    def need_link(self, link):
        if not link:
            raise Failure("its directory of provider libraries is not found; name it with --provider-dir")

    def undo(self, link, replaced, registered):
        """After a failure: what was registered before still needs its link, what was not needs none."""
        if not registered:
            self.host.take_back(self.name)
        elif replaced:
            self.host.put_link(self.name, link, replaced)

    def note(self, link):
        self.host.note(self.name, home=self.home, folders=":".join(dict.fromkeys(map(os.path.dirname, filter(None, self.command.values())))),
                       provider_dir=self.host.provider_dir, library_link=link)

    def say_status(self, found, known, flaw, link):
        """KNOWN: how it is registered, if at all; FLAW: what keeps the registration from serving."""
        if known and os.path.realpath(link or "/") != os.path.realpath(self.product.library):
            flaw = f"{link or 'no link'} does not lead to the library"
        if known and flaw and ":" not in flaw:
            flaw += ": run vk-provider-register install"
        self.host.say(f"{found} is {known or 'not registered'}{f', but {flaw}' if known and flaw else ''}")
        return bool(known and not flaw)
