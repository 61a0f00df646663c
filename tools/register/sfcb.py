"""SFCB registers from files in its staging area, of which its repository is built while the server is down."""

import contextlib
import os
import re
import shutil
from pathlib import Path

from manager import NEWEST_CLASS, Manager
from owner import Failure, match

STAGED = ("vk-baseserver.reg", "vk-baseserver.mof")


def read(path):
    with contextlib.suppress(OSError):
        return Path(path).read_bytes()
    return b""


class Sfcb(Manager):
    name, title, what = "sfcb", "SFCB", "the provider"
    programs = ("sfcbd", "sfcbstage", "sfcbrepos", "sfcbunstage", "sfcbmofpp")

    def find(self):
        self.directories += [f"{self.root}/opt/sfcb/{kind}" for kind in ("sbin", "bin")]
        daemon = self.locate("sfcbd", filter(None, self.directories))
        if not daemon:
            return False
        # The other commands lie beside the daemon, and call each other by their bare names.
        self.home = os.path.dirname(os.path.dirname(os.path.realpath(daemon)))
        self.directories[:0] = [f"{self.home}/sbin", f"{self.home}/bin"]
        self.env["PATH"] = ":".join([*self.directories[:2], os.environ.get("PATH", "")])
        if not super().find():
            return False
        stage = self.place("sfcbstage", "s", "var/lib/sfcb/stage")
        self.staged = stage / "regs" / STAGED[0], stage / "mofs" / self.product.namespace / STAGED[1]
        self.repository = self.place("sfcbrepos", "r", "var/lib/sfcb/registration")
        return True

    def place(self, program, option, usual):
        """A directory as the command's help names it."""
        said = match(rf"-{option} specify .*\[(/.*)\]", self.ask(program, "-h")[1])
        return Path(self.root + said if said else f"{self.home}/{usual}")

    def configured(self, key, default=""):
        text = next(filter(None, (read(f"{home}/etc/sfcb/sfcb.cfg") for home in (self.home, self.root))), b"")
        return match(rf"^\s*{key}\s*:(.*)", text.decode(errors="replace")) or default

    def looks_in(self):
        named = [self.root + directory for directory in self.configured("providerDirs").split()]
        libs = ("lib64", "lib", self.product.multiarch)
        return named + [f"{self.home}/{lib}/{kind}" for kind in ("cmpi", "sfcb") for lib in libs]

    # What the server knows.

    def flaw(self):
        """What its repository lacks of what is to be registered; none where it has nothing of it."""
        register, (mof, _, reg) = read(self.repository / "providerRegister"), self.product.files
        if not any(f"[{name}]".encode() in register for name in self.ours):
            return None
        classes = read(self.repository / "repository" / self.product.namespace / "classSchemas")
        missing = [name for name in self.ours if classes and name.encode() not in classes]
        same = read(reg).strip() in register and read(reg) == read(self.staged[0])
        return self.lacks(missing, same and self.ask("sfcbmofpp", mof) == (0, read(self.staged[1]).decode().strip()))

    def is_there(self):
        return self.is_registered() or any(path.exists() for path in self.staged)

    # Whether the server runs is seen from its processes and its port: its init script's exit status does not say.

    def processes(self):
        found = map(read, Path(f"{self.root}/proc").glob("[0-9]*/stat"))
        return [stat for stat in found if b"(sfcbd) " in stat and b") Z " not in stat]

    def listens(self):
        usual = (("http", "5988", "true"), ("https", "5989", "false"))
        kinds = [(kind, port) for kind, port, on in usual if self.configured(f"enable{kind.title()}", on) == "true"]
        ports = [self.configured(f"{kind}Port", port) for kind, port in kinds]
        sockets = b"".join(read(f"{self.root}/proc/net/{kind}") for kind in ("tcp", "tcp6")).decode()
        return not ports or any(re.search(rf":{int(port):04X} \S+ 0A ", sockets) for port in ports if port.isdigit())

    def service(self):
        """The commands that stop and start the server; none where it does not run."""
        names, systemd = ("sfcb", "sblim-sfcb"), os.path.isdir(f"{self.root}/run/systemd/system")
        systemctl, ways = systemd and self.locate("systemctl"), ("stop", "start")
        for name in names:
            if systemctl and self.call(systemctl, "is-active", "--quiet", name)[0] == 0:
                return [(systemctl, way, name) for way in ways]
        scripts = [f"{place}/etc/init.d/{name}" for place in (self.home, self.root) for name in names]
        script = next((path for path in scripts if os.access(path, os.X_OK)), None)
        if self.processes() and not script:
            unknown = "the server runs, and neither a service manager nor an init script knows it"
            raise Failure(f"{unknown}: stop it and run this again")
        return [(script, way) for way in ways] if self.processes() else None

    @contextlib.contextmanager
    def stopped(self, commands, done="started the server again"):
        with contextlib.ExitStack() as end:
            if commands:
                self.run(*commands[0], done="stopped the server", reached=lambda: not self.processes())
                serves = lambda: self.processes() and self.listens()
                end.callback(self.run_at_last, *commands[1], done=done, reached=serves)
            yield

    # Changing what it knows.

    reached = contextlib.nullcontext  # the files are there whether the server runs or not

    def is_new(self):
        return self.noted.get("library") != self.library()

    def prepare(self, link):
        schema = self.place("sfcbrepos", "c", "share/sfcb/CIM")
        found = b"".join(map(read, schema.rglob(f"{NEWEST_CLASS}.mof"))).decode(errors="replace")
        self.require(link, found if schema.is_dir() else None)
        self.commands = self.service() if self.flaw() != "" or self.is_new() else None

    def build(self, program, *words, done):
        """Changes what is staged and builds the repository of it. If either fails, all is as before: a build that fails
        has put the repository aside, with instances that are nowhere else, and the next would drop them."""
        older, kept = {path: read(path) for path in self.staged if path.exists()}, Path(f"{self.repository}.vk-older")
        if not self.options.dry_run and self.repository.is_dir():
            shutil.rmtree(kept, ignore_errors=True)
            shutil.copytree(self.repository, kept, symlinks=True)
        try:
            self.run(program, "-n", self.product.namespace, *words, done=done)
            self.run("sfcbrepos", "-f", done="built the repository")
        except BaseException:
            if self.options.dry_run:
                raise
            for path in self.staged:
                path.unlink(missing_ok=True)
                if path in older:
                    path.write_bytes(older[path])
            shutil.rmtree(self.repository, ignore_errors=True)
            if kept.is_dir():
                kept.rename(self.repository)
            self.say("put the older repository back")
            raise
        finally:
            shutil.rmtree(kept, ignore_errors=True)

    def register(self):
        if self.flaw() != "":
            with self.stopped(self.commands):
                files = [f"{self.product.share}/{name}" for name in STAGED]
                done = f"registered the provider and its classes in {self.product.namespace}"
                self.build("sfcbstage", "-r", *files, done=done)
        elif self.is_new():
            with self.stopped(self.commands, "had the new library taken into use"):
                pass
        else:
            self.say("the provider is registered already")

    def unregister(self):
        if not self.command["sfcbunstage"]:
            raise Failure("sfcbunstage is not there: what is staged cannot be taken back")
        with self.stopped(self.service()):
            done = f"removed the provider and its classes from {self.product.namespace}"
            self.build("sfcbunstage", "-r", *STAGED, done=done)

    def by_hand(self):
        unstage = f"sfcbunstage -n {self.product.namespace} -r {' '.join(STAGED)}"
        return ("With the server stopped these commands take it back:\n    "
                f"PATH={':'.join(self.directories[:2])}:$PATH; {unstage}; sfcbrepos -f")
