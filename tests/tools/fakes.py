"""Installations of object managers below a root that only record what is asked of them, and remember what real ones do."""

import os
from pathlib import Path

_HEAD = """#!/bin/sh
root=$(cd "$(dirname "$0")/../.." && pwd)
echo "$(basename "$0") $*" >>"$root/calls"
need_up() { [ -e "$root/state/up" ] || { echo "server not running" >&2; exit 1; }; }
"""
_PEGASUS = {
    "cimserver": 'if [ "$1" = -s ]; then rm -f "$root/state/up"; else touch "$root/state/up"; fi',
    "cimprovider": """need_up
case $1 in
-l) cat "$root/state/modules" ;;
-r) grep -qx "$3" "$root/state/modules" || exit 1; : >"$root/state/modules" ;;
esac""",
    "cimmof": """need_up
update=
[ "$1" != -uC ] || { update=yes; shift; }
[ -r "$3" ] || exit 1
case $2 in
root/PG_InterOp)
    [ ! -s "$root/state/modules" ] || { echo "instance already exists" >&2; exit 1; }
    sed -n '/PG_ProviderModule$/,/};/s/.*Name = "\\(VK[A-Za-z]*\\)".*/\\1/p' "$3" >"$root/state/modules" ;;
*)
    [ ! -s "$root/state/classes" ] || [ -n "$update" ] || { echo "class already exists" >&2; exit 1; }
    sed -n 's/^class \\([A-Za-z_]*\\) .*/\\1/p' "$3" >"$root/state/classes" ;;
esac""",
    "cimcli": """need_up
grep -qx "$4" "$root/state/classes" || exit 1
sed -i "/^$4\\$/d" "$root/state/classes" """,
    "cimconfig": """[ -e "$root/state/up" ] || { echo "... because the CIM server is not running."; exit 1; }
echo "Current value: /usr/lib64/Pegasus/providers" """,
}
_SFCB = {
    "sfcbd": "",
    "sfcbstage": '[ ! -e "$root/state/up" ] || exit 1; [ -r "$4" ] && [ -r "$5" ] && touch "$root/state/staged"',
    "sfcbunstage": '[ ! -e "$root/state/up" ] || exit 1; rm "$root/state/staged"',
    "sfcbrepos": '[ ! -e "$root/state/up" ] || exit 1',
    "systemctl": """case "$1 $2 $3" in
"is-active --quiet sfcb") [ -e "$root/state/up" ] ;;
"stop sfcb "*) rm "$root/state/up" ;;
"start sfcb "*) touch "$root/state/up" ;;
*) exit 3 ;;
esac""",
}
_QUESTIONS = ("cimprovider -l", "cimconfig -g", "systemctl is-active")


class Fake:
    def __init__(self, root: Path, programs, up: bool, without=()):
        self.root = root
        (root / "state").mkdir(parents=True, exist_ok=True)
        (root / "state/modules").touch()
        if up:
            (root / "state/up").touch()
        (root / "usr/sbin").mkdir(parents=True, exist_ok=True)
        (root / "usr/local/lib").mkdir(parents=True, exist_ok=True)
        (root / "var/lib").mkdir(parents=True, exist_ok=True)
        for name, body in programs.items():
            if name not in without:
                self.program(name, body)

    def program(self, name: str, body: str) -> None:
        path = self.root / "usr/sbin" / name
        path.write_text(_HEAD + body + "\n", encoding="ascii")
        os.chmod(path, 0o755)

    def calls(self):
        """The commands since the last time that were no mere questions."""
        log = self.root / "calls"
        lines = log.read_text(encoding="utf-8").splitlines() if log.exists() else []
        log.write_text("", encoding="ascii")
        return [line.strip() for line in lines if not line.startswith(_QUESTIONS)]

    @property
    def up(self) -> bool:
        return (self.root / "state/up").exists()


def pegasus(root: Path, up: bool, without=()) -> Fake:
    (root / "usr/lib64/Pegasus/providers").mkdir(parents=True)
    return Fake(root, _PEGASUS, up, without)


def sfcb(root: Path, up: bool, without=()) -> Fake:
    (root / "usr/lib64/cmpi").mkdir(parents=True)
    (root / "etc/sfcb").mkdir(parents=True)
    (root / "etc/sfcb/sfcb.cfg").write_text("httpPort: 5988\nproviderDirs: /usr/lib64/sfcb /usr/lib64/cmpi\n",
                                            encoding="ascii")
    return Fake(root, _SFCB, up, without)
