"""How the provider is made known to SFCB: files in its staging area, of which its repository is built while it is down."""

import contextlib
import os
import re
import shutil
from pathlib import Path

from host import Failure, indented, match
from manager import Manager
from mof import NEWEST_CLASS, declared, require_schema

STAGED = ("vk-baseserver.reg", "vk-baseserver.mof")


class Sfcb(Manager):
    name, title = "sfcb", "SFCB"
    programs = ("sfcbd", "sfcbstage", "sfcbrepos", "sfcbunstage", "sfcbmofpp")

    def find(self):
        self.folders += [f"{self.host.root}/opt/sfcb/{kind}" for kind in ("sbin", "bin")]
        daemon = self.host.find("sfcbd", self.folders)
        if not daemon:
            return False
        # The other commands lie beside the daemon, and call each other by their bare names.
        self.home = os.path.dirname(os.path.dirname(os.path.realpath(daemon)))
        self.folders[:0] = [f"{self.home}/{kind}" for kind in ("sbin", "bin")]
        self.command = {name: self.host.find(name, self.folders) for name in self.programs}
        self.env = dict(os.environ, PATH=":".join([*self.folders[:2], os.environ.get("PATH", "")]))
        if not all(self.command[name] for name in self.programs[:self.needed]):
            return False
        stage = self.place("sfcbstage", "s", "var/lib/sfcb/stage")
        self.staged = stage / "regs" / STAGED[0], stage / "mofs" / self.product.namespace / STAGED[1]
        self.registration = self.place("sfcbrepos", "r", "var/lib/sfcb/registration")
        return True

    def place(self, program, option, usual):
        """A directory as the command's help names it."""
        told = match(rf"-{option} specify .*\[(/.*)\]", self.ask(program, "-h")[1])
        return Path(self.host.root + told if told else f"{self.home}/{usual}")

    def configured(self, key, default=""):
        for file in (f"{self.home}/etc/sfcb/sfcb.cfg", f"{self.host.root}/etc/sfcb/sfcb.cfg"):
            with contextlib.suppress(OSError):
                return match(rf"^\s*{key}\s*:(.*)", Path(file).read_text(encoding="utf-8", errors="replace")) or default
        return default

    def link(self):
        folders = [self.host.root + folder for folder in self.configured("providerDirs").split()]
        folders += [f"{self.home}/{lib}/{kind}" for kind in ("cmpi", "sfcb") for lib in ("lib64", "lib", self.product.multiarch)]
        return self.library_link(folders)

    # What the server knows.

    def flaw(self):
        """What its repository lacks of what is to be registered; none where it has nothing of it."""
        ours = [read(Path(self.product.path(name))) for name in STAGED]
        register = read(self.registration / "providerRegister")
        if not any(f"[{name}]".encode() in register for name in declared(ours[1].decode())):
            return None
        classes = read(self.registration / "repository" / self.product.namespace / "classSchemas")
        missing = [name for name in declared(ours[1].decode()) if classes and name.encode() not in classes]
        if missing:
            return f"without the classes {', '.join(missing)} in {self.product.namespace}"
        same = ours[0].strip() in register and read(self.staged[0]) == ours[0] and (
            self.ask("sfcbmofpp", self.product.path(STAGED[1])) == (0, read(self.staged[1]).decode().strip()))
        return "" if same else "with other classes than those installed"

    def check_schema(self):
        schema = self.place("sfcbrepos", "c", "share/sfcb/CIM")
        if schema.is_dir():
            require_schema("".join(read(path).decode(errors="replace") for path in schema.rglob(f"{NEWEST_CLASS}.mof")))

    # Whether the server runs is seen from its processes and its port: its init script's exit status does not say.

    def processes(self):
        found = [stat for path in Path(f"{self.host.root}/proc").glob("[0-9]*/stat") if b"(sfcbd) " in (stat := read(path))]
        return [stat for stat in found if b") Z " not in stat]

    def listens(self):
        ports = [self.configured("httpPort", "5988")] * (self.configured("enableHttp", "true") == "true")
        ports += [self.configured("httpsPort", "5989")] * (self.configured("enableHttps", "false") == "true")
        sockets = b"".join(read(Path(f"{self.host.root}/proc/net/{kind}")) for kind in ("tcp", "tcp6")).decode()
        return not ports or any(re.search(rf":{int(port):04X} \S+ 0A ", sockets) for port in ports if port.isdigit())

    def service(self):
        """The commands that stop and start the server; none where it does not run."""
        systemctl = os.path.isdir(f"{self.host.root}/run/systemd/system") and self.host.find("systemctl")
        for name in ("sfcb", "sblim-sfcb"):
            if systemctl and self.host.call([systemctl, "is-active", "--quiet", name])[0] == 0:
                return [systemctl, "stop", name], [systemctl, "start", name]
        scripts = [f"{place}/etc/init.d/{name}" for place in (self.home, self.host.root) for name in ("sfcb", "sblim-sfcb")]
        script = next((path for path in scripts if os.access(path, os.X_OK)), None)
        if self.processes() and not script:
            raise Failure("the server runs, and neither a service manager nor an init script knows it: stop it and run this again")
        return ([script, "stop"], [script, "start"]) if self.processes() else None

    @contextlib.contextmanager
    def stopped(self, stop_and_start, done="started the server again"):
        if stop_and_start:
            self.steer(stop_and_start[0], "stopped the server", lambda: not self.processes())
        try:
            yield
        finally:
            try:
                if stop_and_start:
                    self.steer(stop_and_start[1], done, lambda: self.processes() and self.listens())
            except Failure as failure:  # does not hide why the rest failed
                self.host.fail(failure)

    def steer(self, command, done, reached):
        def act():
            _, output = self.host.call(command, self.env)
            if not self.host.comes_true(reached):
                raise Failure(indented(f"failed: {' '.join(command)}", output))
        self.host.change(" ".join(command), act, done)

    # Changing what it knows.

    def build(self, program, *words, done):
        """Changes what is staged and builds the repository of it. If either fails, all is as before: a build that fails
        has put the repository aside, with instances that are nowhere else, and the next would drop them."""
        older, kept = {path: read(path) for path in self.staged if path.exists()}, Path(f"{self.registration}.vk-older")
        if not self.host.dry_run and self.registration.is_dir():
            shutil.rmtree(kept, ignore_errors=True)
            shutil.copytree(self.registration, kept, symlinks=True)
        try:
            self.run(program, "-n", self.product.namespace, *words, done=done)
            self.run("sfcbrepos", "-f", done="built the repository")
        except BaseException:
            for path in self.staged:
                path.unlink(missing_ok=True)
                if path in older:
                    path.write_bytes(older[path])
            shutil.rmtree(self.registration, ignore_errors=True)
            if kept.is_dir():
                kept.rename(self.registration)
            self.host.say("put the older repository back")
            raise
        finally:
            shutil.rmtree(kept, ignore_errors=True)

    def install(self):
        link, flaw = self.link(), self.flaw()
        self.need_link(link)
        self.check_schema()
        new_library = self.noted.get("library") != self.product.identity()
        service = self.service() if flaw != "" or new_library else None
        self.note(link)
        replaced = None
        try:
            replaced = self.host.put_link(self.name, link, self.product.library)
            if flaw != "":
                with self.stopped(service):
                    self.build("sfcbstage", "-r", *map(self.product.path, STAGED),
                               done=f"registered the provider and its classes in {self.product.namespace}")
            elif new_library:
                with self.stopped(service, "had the new library taken into use"):
                    pass
            else:
                self.host.say("the provider is registered already")
        except BaseException:
            self.undo(link, replaced, flaw is not None)
            raise
        self.host.note(self.name, library=self.product.identity())

    def remove(self):
        link = self.link()
        if self.flaw() is None and not any(path.exists() for path in self.staged):
            self.host.say("the provider is not registered")
        else:
            try:
                if not self.command["sfcbunstage"]:
                    raise Failure("sfcbunstage is not there: what is staged cannot be taken back")
                with self.stopped(self.service()):
                    self.build("sfcbunstage", "-r", *STAGED, done=f"removed the provider and its classes from {self.product.namespace}")
            except Failure as failure:
                raise Failure(f"{failure}\nThe provider stays registered. With the server stopped these commands take it back:\n    "
                              f"PATH={':'.join(self.folders[:2])}:$PATH; sfcbunstage -n {self.product.namespace} -r {' '.join(STAGED)}; "
                              f"sfcbrepos -f; rm -f {link}") from failure
        self.host.take_back(self.name, link)

    def status(self):
        flaw = self.flaw()
        return self.say_status(f"found ({self.command['sfcbd']}); the provider", flaw is not None and "registered", flaw, self.link())


def read(path):
    try:
        return path.read_bytes()
    except OSError:
        return b""
