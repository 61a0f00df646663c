"""An OpenPegasus server as it is found: where it lies, whether it runs, and what it knows of the provider."""

import contextlib
import hashlib
import os
import re

from host import match
from manager import Manager
from mof import assignments, blocks, declared, same_class, without_state

STOPPED = "Stopped"
INTEROP = "root/PG_InterOp"


class CimServer(Manager):
    name, title, programs = "openpegasus", "OpenPegasus", ("cimserver", "cimmof", "cimprovider", "cimconfig", "cimcli")

    def find(self):
        root, given = self.host.root, os.environ.get("PEGASUS_HOME")
        home = root + os.path.abspath(given) if given else self.noted.get("home")
        self.folders[:0] = [f"{home}/bin"] if given else []
        self.folders += [f"{root}/opt/tog-pegasus/{kind}" for kind in ("bin", "sbin")]
        self.command = {name: self.host.find(name, self.folders) for name in self.programs}
        if not all(self.command[name] for name in self.programs[:self.needed]):
            return False
        self.home = home or os.path.dirname(os.path.dirname(os.path.realpath(self.command["cimserver"])))
        self.own_home = {} if self.home == f"{root}/usr" else {"PEGASUS_HOME": self.home}
        self.env = dict(os.environ, LC_ALL="C", **self.own_home)
        self.ours = declared(self.product.text("vk-baseserver.mof"))
        return True

    # What the server knows.

    def modules(self):
        """Each module's state by its name; none where the server does not run."""
        code, text = self.ask("cimprovider", "-l", "-s")
        lines = (line.split(None, 1) for line in text.splitlines()[1:])
        return None if code else {words[0]: words[1].strip() for words in lines if len(words) == 2}

    def would_be_started(self):
        return self.host.dry_run and self.modules() is None

    def state(self):
        if self.would_be_started():
            return "OK" if self.noted else None
        return (self.modules() or {}).get(self.product.module)

    def classes(self, instances):
        """Each of our classes that the server has, in an order in which they can be declared."""
        if self.would_be_started():
            return self.ours if self.noted else {}
        older = re.findall(r' ClassName = "(\w+)"', "".join(instances))
        answers = {name: self.ask("cimcli", "gc", "-n", self.product.namespace, name)
                   for name in dict.fromkeys([*(name for name in older if name not in self.ours), *self.ours])}
        return {name: text for name, (code, text) in answers.items() if code == 0}

    def instances(self):
        kinds = ("PG_ProviderModule", "PG_Provider", "PG_ProviderCapabilities")
        ours = re.compile(rf'^ *(Name|ProviderModuleName) = "{self.product.module}";', re.M)
        return [block for kind in kinds for block in blocks(self.ask("cimcli", "ei", "-n", INTEROP, kind)[1]) if ours.search(block)]

    def known(self):
        """The texts of the classes and instances that the server has of the provider."""
        instances = self.instances()
        return self.classes(instances), instances

    def shown(self, classes, instances):
        """A mark of all that the server shows of the provider, and of what it was made from."""
        shown = "".join([*classes.values(), *map(without_state, instances), self.product.checksum()])
        return hashlib.sha256(shown.encode()).hexdigest()

    def flaw(self, classes, instances):
        """What the server lacks of what is to be registered."""
        missing = [name for name in self.ours if self.command["cimcli"] and name not in classes]
        if missing:
            return f"without the classes {', '.join(missing)} in {self.product.namespace}"
        registered = [assignments(block) for block in instances]
        same = self.command["cimcli"] and all(same_class(self.ours[name], classes[name]) for name in self.ours) and all(
            any(assignments(block) <= other for other in registered)
            for block in blocks(self.product.text("vk-baseserver-registration.mof")))
        return "" if same or self.noted.get("shown") == self.shown(classes, instances) else "with other classes than those installed"

    def on_disk(self):
        """Whether a server that is down has the module in its repository; none where that is not seen."""
        for folder in (f"{self.home}/repository", f"{self.host.root}/var/lib/Pegasus/repository"):
            with contextlib.suppress(OSError), open(f"{folder}/root#PG_InterOp/instances/PG_ProviderModule.instances", "rb") as file:
                return self.product.module.encode() in file.read()
        return None

    def link(self):
        """Never in a guessed directory: only the server says where it looks."""
        answers = (match(r"^\w+ value: *(.+)", self.ask("cimconfig", "-g", "providerDir", *words)[1]) for words in ((), ("-p",)))
        said = next(filter(None, answers), "").split(":")
        return self.library_link([self.host.root + folder if folder.startswith("/") else f"{self.home}/{folder}"
                                  for folder in said if folder])
