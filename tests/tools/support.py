"""What the tests of the installed programs share: an installation in a temporary prefix, and running things."""

import atexit
import os
import shutil
import subprocess
import tempfile
from pathlib import Path

BUILD = Path(os.environ["VK_BUILD_DIR"])
NOBODY = 65534
LIBRARY = "libvknabaseserverprofileprovider.so"


def run(*command, **options):
    options = {"capture_output": True, "text": True, "check": False, "stdin": subprocess.DEVNULL, "timeout": 120} | options
    return subprocess.run([str(word) for word in command], **options)


def widest(text):
    return max(map(len, text.splitlines()))


def directory() -> Path:
    """A new directory, removed at the end."""
    made = Path(tempfile.mkdtemp(prefix="vk-tools-"))
    atexit.register(shutil.rmtree, made, ignore_errors=True)
    return made


def run_as_nobody(program: Path, *words, **options):
    """Runs a program as a user without rights; takes root. A copy of it, since the tree may be closed to others."""
    place = directory()
    place.chmod(0o755)
    return run("/usr/bin/setpriv", f"--reuid={NOBODY}", f"--regid={NOBODY}", "--clear-groups", "--inh-caps=-all",
               shutil.copy(program, place), *words, **options)


def install(prefix: Path, destdir=None, component=None) -> subprocess.CompletedProcess:
    words = ["cmake", "--install", BUILD, "--prefix", prefix]
    if component:
        words += ["--component", component]
    env = dict(os.environ, DESTDIR=str(destdir)) if destdir else None
    done = run(*words, env=env)
    assert done.returncode == 0, done.stdout + done.stderr
    return done


def files_below(where: Path):
    return sorted(p for p in where.rglob("*") if p.is_file() or p.is_symlink())


def snapshot_of(where: Path):
    """Every file, link and directory below a directory with what it holds, to see whether anything changed."""
    return {str(p.relative_to(where)): (os.readlink(p) if p.is_symlink() else p.read_bytes() if p.is_file() else None)
            for p in where.rglob("*")}
