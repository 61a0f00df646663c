"""Installations of object managers below a root: the commands of fake_manager.py, and a look at what they were asked."""

import os
import re
import shutil
from pathlib import Path

_COMMANDS = Path(__file__).with_name("fake_manager.py")
_PEGASUS = ("cimserver", "cimprovider", "cimmof", "cimcli", "cimconfig")
_SFCB = ("sfcbd", "sfcbstage", "sfcbunstage", "sfcbrepos", "sfcbmofpp", "systemctl")
_QUESTIONS = re.compile("cimprovider -l|cimconfig -g|cimcli (gc|ei|ni)|systemctl is-active|sfcb(stage|repos) -h|sfcbmofpp")
# What the classes derive from, as a CIM schema of version 2.22 has it.
_FACTS = Path(__file__).resolve().parents[2] / "schema/superclasses.facts"
_SCHEMA = " ".join(re.findall(r"^CIM_\w+", _FACTS.read_text(encoding="utf-8"), re.M))


class Fake:
    def __init__(self, root: Path, programs, without, directories):
        self.root = root
        for directory in ("state", "usr/sbin", "usr/local/lib", "var/lib", *directories):
            (root / directory).mkdir(parents=True, exist_ok=True)
        self.set("schema", _SCHEMA)
        for name in programs:
            if name not in without:
                self.command(f"usr/sbin/{name}")

    def command(self, place: str) -> None:
        (self.root / place).parent.mkdir(parents=True, exist_ok=True)
        shutil.copy(_COMMANDS, self.root / place)
        os.chmod(self.root / place, 0o755)

    def move(self, programs, place: str) -> None:
        (self.root / place).mkdir(parents=True, exist_ok=True)
        for name in programs:
            (self.root / "usr/sbin" / name).rename(self.root / place / name)

    def set(self, what: str, value) -> None:
        (self.root / "state" / what).write_text(str(value), encoding="utf-8")

    def get(self, what: str) -> str:
        file = self.root / "state" / what
        return file.read_text(encoding="utf-8") if file.exists() else ""

    def calls(self):
        """The commands since the last time that were no mere questions."""
        log = self.root / "calls"
        lines = log.read_text(encoding="utf-8").splitlines() if log.exists() else []
        log.write_text("", encoding="ascii")
        return [line.strip() for line in lines if not _QUESTIONS.match(line)]


class Pegasus(Fake):
    commands = _PEGASUS

    @property
    def up(self) -> bool:
        return (self.root / "state/up").exists()

    @property
    def module(self) -> str:
        return self.get("module")

    @property
    def classes(self):
        return sorted(path.name for path in self.root.glob("state/classes/*"))


class Sfcb(Fake):
    commands = _SFCB

    @property
    def up(self) -> bool:
        return "(sfcbd)" in (self.root / "proc/42/stat").read_text(encoding="ascii")

    def run_server(self, up: bool) -> None:
        for directory in ("proc/42", "proc/net"):
            (self.root / directory).mkdir(parents=True, exist_ok=True)
        (self.root / "proc/42/stat").write_text(f"42 ({'sfcbd' if up else 'other'}) S 1 42 42", encoding="ascii")
        (self.root / "proc/net/tcp").write_text("   0: 0100007F:1764 00000000:0000 0A \n" if up else "", encoding="ascii")

    def without_systemd(self, script=True) -> None:
        (self.root / "run/systemd/system").rmdir()
        if script:
            self.command("etc/init.d/sfcb")

    @property
    def staged(self):
        return sorted(path.name for path in self.root.rglob("stage/**/vk-*"))

    @property
    def register(self) -> str:
        return next(self.root.rglob("providerRegister")).read_text(encoding="utf-8")


def pegasus(root: Path, up: bool, without=()) -> Pegasus:
    repository = "var/lib/Pegasus/repository/root#PG_InterOp/instances"
    fake = Pegasus(root, _PEGASUS, without, ["usr/lib64/Pegasus/providers", repository])
    (root / repository / "PG_ProviderModule.instances").touch()
    if up:
        (root / "state/up").touch()
    return fake


def sfcb(root: Path, up: bool, without=()) -> Sfcb:
    fake = Sfcb(root, _SFCB, without, ["usr/lib64/cmpi", "etc/sfcb", "run/systemd/system", "usr/share/sfcb/CIM/Core",
                                       "var/lib/sfcb/registration", "var/lib/sfcb/stage/mofs"])
    (root / "etc/sfcb/sfcb.cfg").write_text("httpPort: 5988\nproviderDirs: /usr/lib64/sfcb /usr/lib64/cmpi\n", encoding="ascii")
    (root / "usr/share/sfcb/CIM/Core/CIM_TimeService.mof").write_text('[Version ( "2.22.0" )]\nclass CIM_TimeService\n', encoding="ascii")
    fake.run_server(up)
    return fake
