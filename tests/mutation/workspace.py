"""The copy of the checkout that is mutated, with a build tree of its own.

It takes the checkout's place in a sandbox, so that a build tree copied with it goes on where it was. All else there is
read-only, or in memory: whatever a mutant does with the host's files, clock, names or processes, it does to nothing.
"""
import fcntl
import os
import shutil
import signal
import subprocess
import tempfile

BUILD = "build"
# A mutant that loops may log without end, or fill the memory.
LIMITS = [f"--fsize={1 << 28}", f"--as={8 << 30}", "--core=0"]
PATIENCE = 4  # seconds that may pass for each that a process may compute: it sleeps, and others compute, too


class Failure(Exception):
    """The unchanged copy does not do what it should, or cannot be made."""


class Workspace:
    def __init__(self, root, directory, jobs):
        self.root = root
        self.tree = directory / "tree"
        self.log = directory / "log"
        self.reached = root / BUILD / "reached"  # in the sandbox
        self.jobs = jobs
        self.tree.mkdir(parents=True, exist_ok=True)
        self.lock = open(directory / "lock", "w", encoding="ascii")
        try:
            fcntl.flock(self.lock, fcntl.LOCK_EX | fcntl.LOCK_NB)
        except OSError as error:
            self.lock.close()
            raise Failure(f"another run uses {directory}") from error

    def take_over(self):
        """Makes the copy's sources equal to the checkout's; what is equal already keeps its time."""
        listed = subprocess.run(["git", "ls-files", "-z", "--cached", "--others", "--exclude-standard"], cwd=self.root,
                                check=True, stdout=subprocess.PIPE).stdout.decode().split("\0")
        wanted = {name for name in listed if name and (self.root / name).is_file()}
        build = self.tree / BUILD
        if not build.exists() and (self.root / BUILD / "build.ninja").is_file():
            subprocess.run(["cp", "-a", "--reflink=auto", self.root / BUILD, build], check=True)
        for name in wanted:
            source, target = self.root / name, self.tree / name
            if not target.is_file():
                target.parent.mkdir(parents=True, exist_ok=True)
                shutil.copy2(source, target)  # with its time: the build tree that came with it is up to date
            elif target.read_bytes() != source.read_bytes():
                shutil.copyfile(source, target)
            shutil.copymode(source, target)
        for top in [path for path in self.tree.iterdir() if path != build]:
            for target in [top, *top.rglob("*")]:
                if target.is_file() and str(target.relative_to(self.tree)) not in wanted:
                    target.unlink()

    def configure(self):
        query = self.tree / BUILD / ".cmake/api/v1/query/codemodel-v2"
        query.parent.mkdir(parents=True, exist_ok=True)
        query.touch()
        (self.tree / BUILD / "Testing").mkdir(exist_ok=True)
        (self.tree / BUILD / "reached").touch()
        # A program is not linked again because a library's insides have changed.
        command = ["cmake", "--preset", "release", "-DCMAKE_LINK_DEPENDS_NO_SHARED=ON", "-DBUILD_TESTING=ON"]
        if self.logged(command) != 0:
            raise Failure(f"the copy cannot be configured:\n{self.log.read_text(errors='replace')[-2000:]}")

    def sandboxed(self, command, *places):
        return ["bwrap", "--ro-bind", "/", "/", "--dev", "/dev", "--proc", "/proc", "--tmpfs", "/tmp",
                *(places or ("--bind", self.tree, self.root)), "--unshare-pid", "--unshare-ipc", "--unshare-uts", "--unshare-net",
                "--cap-drop", "CAP_SYS_TIME", "--die-with-parent", "--chdir", self.root, "--", *command]

    def logged(self, command):
        with open(self.log, "w", encoding="utf-8") as log:
            return subprocess.run(self.sandboxed(command), stdout=log, stderr=log, stdin=subprocess.DEVNULL, check=False,
                                  env={**os.environ, "TMPDIR": "/tmp", "CCACHE_DISABLE": "1"}).returncode

    def output(self, command):
        return subprocess.run(self.sandboxed(command), check=True, stdout=subprocess.PIPE, stdin=subprocess.DEVNULL).stdout

    def build(self, targets, *options):
        """None when the targets are built; else what went wrong."""
        if self.logged(["cmake", "--build", BUILD, "-j", str(self.jobs), "--target", *targets, "--", *options]) == 0:
            return None
        said = self.log.read_text(errors="replace")
        # A program that is built is asked for its tests at once.
        return "cannot start" if "Error running test executable" in said else "does not compile"

    def run(self, command, seconds, environment=None, mutant=None, reached=None):
        """The status and output of a command, as a mutant or none; a status of None when it did not end in time. A file
        given as `reached` learns which mutants' places were, and there is no mutant then."""
        places = ["--ro-bind", self.tree, self.root, "--tmpfs", self.root / BUILD / "Testing"]
        if reached:
            places += ["--bind", reached, self.reached]
        limits = LIMITS + [f"--rss={0 if reached else mutant or 'unlimited'}:", f"--cpu={seconds}"]
        with tempfile.TemporaryFile() as output:
            child = subprocess.Popen(["prlimit", *limits, *self.sandboxed(command, *places)], stdout=output,
                                     stderr=subprocess.STDOUT, stdin=subprocess.DEVNULL, start_new_session=True,
                                     env={**os.environ, "TMPDIR": "/tmp", **(environment or {})})
            try:
                status = child.wait(PATIENCE * seconds)
            except subprocess.TimeoutExpired:
                status = None
            finally:
                if child.poll() is None:
                    os.killpg(child.pid, signal.SIGKILL)
                    child.wait()
            output.seek(0)
            return status, output.read().decode(errors="replace")
