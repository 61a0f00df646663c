"""Commands of the host that the object managers run on, and the notes and links that are made there."""

import contextlib
import os
import re
import subprocess
import sys
import tempfile
import time
from pathlib import Path


class Failure(Exception):
    """Why something cannot be done, with what a command said; ends the work for one owner."""

    def __init__(self, text, output=""):
        super().__init__("\n    ".join([text, *output.splitlines()]))


def match(pattern, text):
    found = re.search(pattern, text, re.M)
    return found[1].strip() if found else None


class Owner:
    """One for whom notes and links are made, by NAME; TITLE stands before what it says."""
    title = ""

    def __init__(self, options):
        self.options, self.product, self.root, self.env = options, options.product, options.root, dict(os.environ)
        self.usual = [f"{self.root}{place}/{kind}" for place in ("/usr", "", "/usr/local") for kind in ("sbin", "bin")]
        self.usual += [] if self.root else filter(None, os.environ.get("PATH", "").split(":"))

    def say(self, text):
        print(f"{self.title and self.title + ': '}{text}", flush=True)

    def fail(self, failure):
        named = isinstance(failure, OSError) and failure.filename
        text = f"{failure.filename}: {failure.strerror}" if named else failure
        print(f"vk-provider-register: {self.title and self.title + ': '}{text}", file=sys.stderr, flush=True)
        self.options.failed = True

    # Commands.

    def locate(self, name, directories=(), but_not=None):
        """The first command of that name in DIRECTORIES, where commands usually are, or on this host in PATH."""
        directories = [directory for directory in [*directories, *self.usual] if os.path.realpath(directory) != but_not]
        found = (os.path.abspath(f"{directory}/{name}") for directory in directories)
        return next((file for file in found if os.path.isfile(file) and os.access(file, os.X_OK)), None)

    def call(self, *command):
        # Into a file: a server that is started may hold its output open for ever.
        with tempfile.TemporaryFile("w+", encoding="utf-8", errors="replace") as output:
            try:
                code = subprocess.call(command, stdin=subprocess.DEVNULL, stdout=output, stderr=output, env=self.env)
            except OSError as error:
                return 127, str(error)
            output.seek(0)
            return code, output.read().strip()

    def run(self, *command, done="", reached=None):
        """Runs a command that changes something; DONE is said when it worked, as its exit status says or REACHED."""
        if self.options.dry_run:
            print(f"would run: {' '.join(command)}", flush=True)
            return
        code, output = self.call(*command)
        if not self.comes_true(reached) if reached else code:
            raise Failure(f"failed: {' '.join(command)}", output)
        if done:
            self.say(done)

    @staticmethod
    def comes_true(condition):
        """Asks again for half a minute."""
        for _ in range(30):
            if condition():
                return True
            time.sleep(float(os.environ.get("VK_REGISTER_PAUSE", "1")))
        return condition()

    # Notes: lines "KEY: VALUE", one file for each owner, so that a later run needs neither the options nor the
    # variables of this one. NAME.links names the links that were made, "LINK -> TARGET" a line: what is not named
    # there, or leads elsewhere by now, is somebody else's. A path may hold any bytes.

    def file(self, ending=""):
        return Path(f"{self.options.state}/{self.name}{ending}")

    def read(self, ending=""):
        with contextlib.suppress(OSError):
            return self.file(ending).read_text(encoding="utf-8", errors="surrogateescape").splitlines()
        return []

    def write(self, lines, ending=""):
        if not self.options.dry_run:
            self.options.state.mkdir(parents=True, exist_ok=True)
            text = "".join(f"{line}\n" for line in lines)
            self.file(f"{ending}.new").write_text(text, encoding="utf-8", errors="surrogateescape")
            self.file(f"{ending}.new").replace(self.file(ending))

    def notes(self):
        return dict(line.split(": ", 1) for line in self.read() if ": " in line)

    def note(self, **values):
        lines = self.notes() | {key.replace("_", "-"): value for key, value in values.items() if value}
        self.write(f"{key}: {value}" for key, value in lines.items())

    def is_ours(self, link):
        return os.path.islink(link) and f"{link} -> {os.readlink(link)}" in self.read(".links")

    def put_link(self, link, target):
        """Replaces only what was made here, or led to another installation of our library; returns what it replaced."""
        there, directory = os.readlink(link) if os.path.islink(link) else None, os.path.dirname(link)
        if there == target:
            self.say(f"{link} links to {target} already")
            return None
        if there is None and os.path.exists(link):
            raise Failure(f"{link} is there and no link: not replaced")
        if there and not self.is_ours(link) and os.path.basename(there) != os.path.basename(self.product.library):
            raise Failure(f"{link} links to {there}, which is not ours: not replaced")
        # Noted before it is made: a note of a missing link does no harm.
        self.write([*self.read(".links"), f"{link} -> {target}"], ".links")
        if not os.path.isdir(directory):
            self.run("mkdir", "-p", directory)
        # At one stroke: a server that loads it at this moment finds the old one or the new one.
        self.run("ln", "-sfn", target, f"{link}.new")
        self.run("mv", "-fT", f"{link}.new", link, done=f"linked {link} to {target}")
        return there

    def forget(self, usual=None):
        """Removes every link that was made, and the notes. USUAL is where a link would be, and is named if it stays."""
        for link in sorted({*(line.split(" -> ")[0] for line in self.read(".links")), usual} - {None}):
            if self.is_ours(link):
                self.run("rm", "-f", link, done=f"removed the link {link}")
            elif os.path.islink(link):
                self.say(f"{link} leads to {os.readlink(link)}, was not made here and stays")
        self.options.forgotten.add(self.name)
        if not self.options.dry_run:
            for ending in ("", ".links"):
                self.file(ending).unlink(missing_ok=True)
