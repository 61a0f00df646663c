"""The host that the object managers run on: its commands, and the notes and links that are made there."""

import os
import re
import subprocess
import sys
import tempfile
import time
from pathlib import Path


class Failure(Exception):
    """Why something cannot be done; ends the work for one object manager."""


def indented(text, output):
    return "\n    ".join([text, *output.splitlines()])


def match(pattern, text):
    found = re.search(pattern, text, re.M)
    return found[1].strip() if found else None


class Host:
    usual = [f"{place}/{kind}" for place in ("/usr", "", "/usr/local") for kind in ("sbin", "bin")]

    def __init__(self, product, root, dry_run, provider_dir):
        self.product, self.root, self.dry_run, self.provider_dir = product, root, dry_run, provider_dir
        self.state = Path(f"{root}/var/lib/vk/registration")
        self.forgotten, self.prefix, self.failed = set(), "", False

    def say(self, text):
        print(f"{self.prefix}{text}", flush=True)

    def fail(self, text):
        if isinstance(text, OSError) and text.filename:
            text = f"{text.filename}: {text.strerror}"
        print(f"vk-provider-register: {self.prefix}{text}", file=sys.stderr, flush=True)
        self.failed = True

    def find(self, name, folders=(), but_not=None):
        """The first command of that name in FOLDERS, where commands usually are, or on this host in PATH."""
        folders = [*folders, *(self.root + usual for usual in self.usual)]
        for folder in filter(None, folders + ([] if self.root else os.environ.get("PATH", "").split(":"))):
            found = os.path.abspath(f"{folder}/{name}")
            if os.path.isfile(found) and os.access(found, os.X_OK) and os.path.realpath(folder) != but_not:
                return found
        return None

    @staticmethod
    def call(command, env=None):
        # Into a file: a server that is started may hold its output open for ever.
        with tempfile.TemporaryFile("w+", encoding="utf-8", errors="replace") as output:
            try:
                done = subprocess.run(command, stdin=subprocess.DEVNULL, stdout=output, stderr=output, env=env, check=False)
            except OSError as error:
                return 127, str(error)
            output.seek(0)
            return done.returncode, output.read().strip()

    def run(self, command, done="", env=None):
        """Runs a command that changes something; DONE is said when it worked."""
        def checked():
            code, output = self.call(command, env)
            if code:
                raise Failure(indented(f"failed: {' '.join(command)}", output))
        self.change(" ".join(command), checked, done)

    def change(self, words, function, done=""):
        if self.dry_run:
            print(f"would run: {words}", flush=True)
            return
        try:
            function()
        except OSError as error:
            raise Failure(f"failed: {words}: {error.strerror}") from error
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

    # Notes: lines "KEY: VALUE", one file for each object manager: where it is and how it was served, so that a later run
    # needs neither the options nor the variables of this one.

    def read(self, name):
        # A path may hold any bytes.
        return (self.state / name).read_text(encoding="utf-8", errors="surrogateescape").splitlines()

    def notes(self, owner):
        try:
            lines = self.read(owner)
        except OSError:
            return {}
        return dict(line.split(": ", 1) for line in lines if ": " in line)

    def note(self, owner, **values):
        lines = self.notes(owner) | {key.replace("_", "-"): value for key, value in values.items() if value}
        self.write(owner, [f"{key}: {value}" for key, value in lines.items()])

    def write(self, name, lines):
        if self.dry_run:
            return
        try:
            self.state.mkdir(parents=True, exist_ok=True)
            new = self.state / f"{name}.new"
            new.write_text("".join(f"{line}\n" for line in lines), encoding="utf-8", errors="surrogateescape")
            new.replace(self.state / name)
        except OSError as error:
            raise Failure(f"cannot write {self.state / name}: {error.strerror}") from error

    def take_back(self, owner, link=None):
        self.take_links(owner, link)
        self.forgotten.add(owner)
        if not self.dry_run:
            (self.state / owner).unlink(missing_ok=True)

    def any_noted(self, owners):
        return any((self.state / owner).exists() for owner in owners if owner not in self.forgotten)

    # Links: OWNER.links names those that were made, "LINK -> TARGET" a line. What is not named there, or leads elsewhere
    # by now, is somebody else's.

    def made_links(self, owner):
        try:
            return self.read(f"{owner}.links")
        except OSError:
            return []

    def is_ours(self, owner, link):
        return os.path.islink(link) and f"{link} -> {os.readlink(link)}" in self.made_links(owner)

    def put_link(self, owner, link, target):
        """Replaces only what was made here, or led to another installation of our library; returns what it replaced."""
        there = os.readlink(link) if os.path.islink(link) else None
        if there == target:
            self.say(f"{link} links to {target} already")
            return None
        if there is None and os.path.exists(link):
            raise Failure(f"{link} is there and no link: not replaced")
        if there and not self.is_ours(owner, link) and os.path.basename(there) != os.path.basename(self.product.library):
            raise Failure(f"{link} links to {there}, which is not ours: not replaced")
        # Noted before it is made: what is noted and not there does no harm.
        self.write(f"{owner}.links", [*self.made_links(owner), f"{link} -> {target}"])
        if not os.path.isdir(os.path.dirname(link)):
            self.change(f"mkdir -p {os.path.dirname(link)}", lambda: os.makedirs(os.path.dirname(link)))
        # At one stroke: a server that loads it at this moment finds the old one or the new one.
        self.run(["ln", "-sfn", target, f"{link}.new"])
        self.run(["mv", "-fT", f"{link}.new", link], f"linked {link} to {target}")
        return there

    def take_links(self, owner, usual=None):
        """Removes every link made for OWNER. USUAL is where one would be, and is named if it stays."""
        for link in sorted({line.split(" -> ")[0] for line in self.made_links(owner)} | ({usual} if usual else set())):
            if self.is_ours(owner, link):
                self.run(["rm", "-f", link], f"removed the link {link}")
            elif os.path.islink(link):
                self.say(f"{link} leads to {os.readlink(link)}, was not made here and stays")
        if not self.dry_run:
            (self.state / f"{owner}.links").unlink(missing_ok=True)
