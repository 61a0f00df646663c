"""An OpenPegasus server as it is found: where it lies, whether it runs, and what it knows of the provider."""

import contextlib
import os
import re
from collections import namedtuple
from pathlib import Path

from manager import Manager, digest
from owner import match

STOPPED, INTEROP, TEXT = "Stopped", "root/PG_InterOp", r'"(?:[^"\\]|\\.)*"'
# What the server has of the provider: the module's state, the texts of classes by their names, and those of instances.
Known = namedtuple("Known", "state classes instances")


def blocks(mof):
    return re.findall(r"^instance of .*?^\};", mof, re.M | re.S)


def assignments(block):
    return {block.split()[2], *(line.strip() for line in block.splitlines() if " = " in line and "= NULL" not in line)}


def without_state(block):
    """An instance as it can be registered: the module's state is the server's own."""
    return re.sub(r"^.*(= NULL|OperationalStatus = .*);\n", "", block, flags=re.M)


def same_class(ours, theirs):
    """The server breaks texts elsewhere and adds inherited qualifiers; it adds no property and no method."""
    plain = [re.sub(r"^\s*//.*", "", text, flags=re.M) for text in (ours, theirs)]
    joined = [re.sub(r'"\s*"', "", text).replace("\\'", "'") for text in plain]
    words = [set(re.findall(rf"{TEXT}|\w+", text)) for text in joined]
    features = [set(re.findall(r"(\w+)(?:\[\])?;|(\w+)\(\s*\[", re.sub(TEXT, "", text))) for text in joined]
    return words[0] <= words[1] and features[0] == features[1]


class CimServer(Manager):
    name, title, programs = "openpegasus", "OpenPegasus", ("cimserver", "cimmof", "cimprovider", "cimconfig", "cimcli")

    def find(self):
        given = os.environ.get("PEGASUS_HOME")
        home = self.root + os.path.abspath(given) if given else self.noted.get("home")
        self.directories[:0] = [f"{home}/bin"] if given else []
        self.directories += [f"{self.root}/opt/tog-pegasus/{kind}" for kind in ("bin", "sbin")]
        if not super().find():
            return False
        self.home = home or os.path.dirname(os.path.dirname(os.path.realpath(self.command["cimserver"])))
        self.own_home = {} if self.home == f"{self.root}/usr" else {"PEGASUS_HOME": self.home}
        self.env.update(self.own_home, LC_ALL="C")
        self.module, self.what = ["-m", self.product.module], f"the module {self.product.module}"
        return True

    def looks_in(self):
        """Never a guessed directory: only the server says where it looks."""
        answers = (self.ask("cimconfig", "-g", "providerDir", *planned)[1] for planned in ((), ("-p",)))
        said = next(filter(None, (match(r"^\w+ value: *(.+)", text) for text in answers)), "").split(":")
        directories = filter(None, said)
        return [self.root + directory if directory.startswith("/") else f"{self.home}/{directory}" for directory in directories]

    def modules(self):
        """Each module's state by its name; none where the server does not run."""
        code, text = self.ask("cimprovider", "-l", "-s")
        return None if code else dict(re.findall(r"^[ \t]*(\S+)[ \t]+(\S.*?)[ \t]*$", text, re.M))

    def on_disk(self):
        """Whether a server that is down has the module in its repository; none where that is not seen."""
        for directory in (f"{self.home}/repository", f"{self.root}/var/lib/Pegasus/repository"):
            with contextlib.suppress(OSError):
                modules = Path(f"{directory}/root#PG_InterOp/instances/PG_ProviderModule.instances")
                return self.product.module.encode() in modules.read_bytes()
        return None

    def state(self):
        """The module's; none where it is not registered. A server that is down has what is noted or on its disk."""
        modules = self.modules()
        if modules is None:
            return "OK" if self.noted or self.on_disk() else None
        return modules.get(self.product.module)

    is_registered = state

    def known(self):
        """Classes in an order in which they can be declared."""
        if self.modules() is None:
            return Known(self.state(), self.ours if self.state() else {}, [])
        kinds = ("PG_ProviderModule", "PG_Provider", "PG_ProviderCapabilities")
        shown = [block for kind in kinds for block in blocks(self.ask("cimcli", "ei", "-n", INTEROP, kind)[1])]
        ours = re.compile(rf'^ *(Name|ProviderModuleName) = "{self.product.module}";', re.M)
        instances = [block for block in shown if ours.search(block)]
        older = re.findall(r' ClassName = "(\w+)"', "".join(instances))
        names = dict.fromkeys([*(name for name in older if name not in self.ours), *self.ours])
        answers = {name: self.ask("cimcli", "gc", "-n", self.product.namespace, name) for name in names}
        classes = {name: text for name, (code, text) in answers.items() if code == 0}
        return Known(self.state(), classes, instances)

    def mark(self, known):
        """Of all that the server shows of the provider, and of what it was made from."""
        return digest(*known.classes.values(), *map(without_state, known.instances), self.checksum)

    def difference(self, known):
        """What the server lacks of what is to be registered."""
        cimcli, registered = self.command["cimcli"], [assignments(block) for block in known.instances]
        missing = [name for name in self.ours if cimcli and name not in known.classes]
        same = cimcli and not missing and all(same_class(self.ours[name], known.classes[name]) for name in self.ours)
        wanted = map(assignments, blocks(self.registration))
        same = same and all(any(each <= other for other in registered) for each in wanted)
        return self.lacks(missing, same or self.noted.get("shown") == self.mark(known))

    def flaw(self):
        """What keeps the registration from serving; none where nothing is registered."""
        if self.modules() is None:
            return "" if self.on_disk() or self.on_disk() is None and self.noted else None
        known = self.known()
        starting = self.starting() if known.state == STOPPED else ""
        return self.difference(known) or starting if known.state else None

    def is_there(self):
        known = self.known()
        return known.state or known.classes

    def starting(self):
        return f"was stopped by the administrator: cimprovider -e {' '.join(self.module)} starts it"

    def status(self):
        up = self.modules() is not None
        known = "registered" if up or self.on_disk() else "registered, as far as can be seen"
        return super().status(", running" if up else ", not running", known)
