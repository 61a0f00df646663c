"""The optional ntpd, init script and vk-ntp-setup on hosts whose daemons are scripts, in a file system of their own; with real
daemons tests/system/ntp_daemon tries them."""

import os
import shutil
import subprocess
import unittest
from pathlib import Path

from support import NOBODY, directory, install, run, widest

SOURCE = Path(__file__).resolve().parents[2]
PREFIX = "/opt/vk"
WRAPPER, SCRIPT = f"{PREFIX}/lib/vk/ntp/ntpd", f"{PREFIX}/lib/vk/ntp/ntp"
NO_RESULT = "did not synchronise the clock within 1 seconds"
SYSTEM = ("/usr/bin", "/usr/lib", "/usr/lib64")
MADE = directory()
install(PREFIX, destdir=MADE, component="ntp")

# A chronyd whose reference time changes with each burst.
CHRONYC = """
case "$*" in
"-c tracking") echo "0A630001,10.99.0.1,6,$(cat /tmp/reference 2>/dev/null).5,{offset},0.1,0.1,0.1,0,0,1,0,0,2,Normal" ;;
"burst 4/8") echo "{burst}"; [ "{burst}" = "200 OK" ] || exit 1; {answer} ;;
makestep) echo "{step}"; [ "{step}" = "200 OK" ] || exit 1 ;;
waitsync*) [ "{synchronised}" = yes ] ;;
esac"""
ANSWERS = {"offset": "0.000012345", "burst": "200 OK", "answer": "echo 7 >/tmp/reference", "step": "200 OK", "synchronised": "yes"}

# One unit, whose state is a file.
SYSTEMCTL = """
case "$*" in
"-q is-active {unit}") [ -e /tmp/active ] ;;
"-q cat {unit}") echo "[Unit]" ;;
"start {unit}" | "restart {unit}") {start} ;;
"stop {unit}") {stop} ;;
*) exit 3 ;;
esac"""


class Host:
    """A host with the system's commands and these, each of them a script."""

    def __init__(self, **commands):
        self.root = directory()
        for name in ("dev", "etc/init.d", "opt", "proc", "run", "tmp", "usr/local/sbin", "usr/sbin"):
            (self.root / name).mkdir(parents=True)
        for name in ("bin", "lib", "lib64"):
            (self.root / name).symlink_to(f"usr/{name}")
        for name, text in commands.items():
            self.add(f"usr/sbin/{name}", text)

    def add(self, name, text):
        path = self.root / name
        path.write_text(f'#!/bin/sh\necho "{name.split("/")[-1]} $*" >>/tmp/calls\n{text}\n')
        path.chmod(0o755)
        return self

    def with_systemd(self, unit, start=": >/tmp/active", stop="rm /tmp/active", active=False):
        (self.root / "run/systemd/system").mkdir(parents=True)
        if active:
            (self.root / "tmp/active").touch()
        return self.add("usr/sbin/systemctl", SYSTEMCTL.format(unit=unit, start=start, stop=stop))

    def run(self, *command, **env):
        env = {"PATH": "/usr/local/sbin:/usr/local/bin:/usr/sbin:/usr/bin", **env}
        words = ["bwrap", "--unshare-all", "--die-with-parent", "--bind", self.root, "/", "--ro-bind", MADE / "opt", "/opt"]
        for place in filter(os.path.isdir, SYSTEM):
            words += ["--ro-bind", place, place]
        return run(*words, "--proc", "/proc", "--dev", "/dev", *command, env=env)

    def synchronise(self, limit=60):
        """The first line, which is all that the time service reads."""
        return self.run(WRAPPER, "-xgq", VK_NTP_LIMIT=str(limit)).stdout.partition("\n")[0]

    def control(self, action):
        return self.run(SCRIPT, action).stdout.partition("\n")[0]

    def setup(self, action):
        return self.run(f"{PREFIX}/sbin/vk-ntp-setup", action)

    def calls(self):
        path = self.root / "tmp/calls"
        return path.read_text().splitlines() if path.exists() else []


def chronyc(**answers):
    return CHRONYC.format(**{**ANSWERS, **answers})


def ntpd(version, *lines, end=""):
    """A real ntpd: says its version, and the lines when it is to synchronise."""
    said = "\n".join(f'echo "{line}"' for line in lines)
    return f'case "$*" in --version) echo "{version}" ;; -xgq | "-d -s") {said or ":"}\n{end or ":"} ;; *) echo "did $*" ;; esac'


def unread(path):
    """What a file is, but for when it was read last."""
    status = path.lstat()
    return [getattr(status, field) for field in dir(status) if field.startswith("st_") and not field.startswith("st_atime")]


class Test(unittest.TestCase):
    @classmethod
    def setUpClass(cls):
        if run("bwrap", "--ro-bind", "/", "/", "--unshare-all", "true").returncode != 0:
            raise unittest.SkipTest("bubblewrap is missing, or makes no file systems here")

    def expect(self, host, line):
        self.assertEqual(host.synchronise(limit=1 if NO_RESULT in line else 60), f"ntpd: {line}")

    def refuse(self, host, reason):
        self.expect(host, f"not synchronised: {reason}")


class RunningChronyd(Test):
    def test_slews_what_is_below_half_a_second_and_steps_what_is_not(self):
        for offset, line in [("0.000012345", "time slew +0.000012345s"), ("-0.499999999", "time slew -0.499999999s"),
                             ("0.500000000", "time set +0.500000000s"), ("-3600.000000000", "time set -3600.000000000s")]:
            with self.subTest(offset):
                host = Host(chronyc=chronyc(offset=offset))
                self.expect(host, line)
                self.assertEqual("chronyc makestep" in host.calls(), "set" in line)

    def test_gives_the_reason(self):
        for answers, reason in [({"burst": "501 Not authorised"}, "chronyd: 501 Not authorised"),
                                ({"answer": ":"}, f"chronyd {NO_RESULT}"),
                                ({"synchronised": "no"}, f"chronyd {NO_RESULT}"),
                                ({"offset": "7.000000000", "step": "500 Failure"},
                                 "chronyd cannot step the clock by 7.000000000 seconds: 500 Failure")]:
            with self.subTest(answers):
                self.refuse(Host(chronyc=chronyc(**answers)), reason)


class Timesyncd(Test):
    ANSWER = "mkdir -p /run/systemd/timesync; : >/run/systemd/timesync/synchronized"

    TIMEDATECTL = """
case "$*" in
"show -p NTPSynchronized --value") echo {kernel} ;;
timesync-status) echo "       Server: 10.99.0.1"; echo "       Offset: {offset}" ;;
esac"""

    def host(self, offset, start=ANSWER, active=True, kernel="yes"):
        return Host(timedatectl=self.TIMEDATECTL.format(offset=offset, kernel=kernel)).with_systemd(
            "systemd-timesyncd", start=start, active=active)

    def test_is_restarted_and_its_offset_passed_on(self):
        for offset, line in [("-285us", "time slew -285us"), ("+399.9ms", "time slew +399.9ms"), ("+4ms", "time slew +4ms"),
                             ("+400ms", "time set +400ms"), ("-512.125ms", "time set -512.125ms"),
                             ("+1min 2.5s", "time set +1min 2.5s"), ("", "time slew (offset not known)")]:
            with self.subTest(offset):
                host = self.host(offset)
                self.expect(host, line)
                self.assertIn("systemctl restart systemd-timesyncd", host.calls())

    def test_gives_the_reason(self):
        self.refuse(self.host("+1ms", start=":"), f"systemd-timesyncd {NO_RESULT}")
        self.refuse(self.host("+1ms", kernel="no"), f"systemd-timesyncd {NO_RESULT}")
        self.refuse(self.host("+1ms", start="exit 1"), "systemd-timesyncd cannot be restarted")

    def test_is_not_started_where_it_does_not_run(self):
        host = self.host("+1ms", active=False)
        self.assertIn("no NTP daemon was found", host.synchronise())
        self.assertNotIn("systemctl restart systemd-timesyncd", host.calls())


class OneShot(Test):
    def test_of_ntpsec_is_heard_behind_its_greeting(self):
        greeting = "2026-11-22T08:04:05 ntpd[19]: INIT: ntpd ntpsec-1.2.2: Starting"
        for line in ("time slew +0.000007s", "time set -700.000001s"):
            self.expect(Host(ntpd=ntpd("ntpd ntpsec-1.2.2", greeting, f"ntpd: {line}")), line)
        self.refuse(Host(ntpd=ntpd("ntpd ntpsec-1.2.2", greeting, "2026-11-22T08:04:06 ntpd[19]: IO: unable to bind")),
                    "ntpsec: ntpd[19]: IO: unable to bind")

    def test_of_ntpsec_has_a_time_limit(self):
        self.refuse(Host(ntpd=ntpd("ntpd ntpsec-1.2.2", "greeting", end="exec sleep 100")), f"ntpsec {NO_RESULT}")

    def openntpd(self, *lines, end="exec sleep 100"):
        return Host(ntpd=ntpd("usage: ntpd [-dnSsv] [-f file] [-p file]", "ntp engine ready", *lines, end=end))

    def test_of_openntpd_is_ended_when_it_has_spoken(self):
        host = self.openntpd("set local clock to Sun Nov 22 08:00:00 UTC 2026 (offset 0.012000s)")
        done = host.run("/bin/sh", "-c", f"{WRAPPER} -xgq; ps -e -o args")
        self.assertEqual(done.stdout.partition("\n")[0], "ntpd: time set +0.012000s")
        self.assertIn("ps -e", done.stdout)
        self.assertNotIn("sleep 100", done.stdout)
        self.assertEqual(list((host.root / "tmp").glob("tmp.*")), [])
        self.expect(self.openntpd("adjusting local clock by -0.000012s"), "time slew -0.000012s")

    def test_of_openntpd_gives_the_reason(self):
        self.refuse(self.openntpd("settimeofday: Operation not permitted"), "openntpd: settimeofday: Operation not permitted")
        self.refuse(self.openntpd("/etc/openntpd/ntpd.conf:1: syntax error", end="exit 1"),
                    "openntpd: /etc/openntpd/ntpd.conf:1: syntax error")
        self.refuse(self.openntpd("fatal: pipe closed", "ntp engine exiting", "Terminating", end="exit 1"),
                    "openntpd: fatal: pipe closed")
        self.refuse(self.openntpd(), f"openntpd {NO_RESULT}")

    def test_of_chronyd_sets_the_clock(self):
        wrong = "2026-11-22T08:01:24Z System clock wrong by {} seconds (step)"
        for lines, status, line in [
                ([wrong.format("-0.000013")], 0, "time set -0.000013s"), ([wrong.format("12.5")], 0, "time set +12.5s"),
                ([wrong.format("0.1"), "2026-11-22T08:01:24Z Could not step system clock"], 0,
                 "not synchronised: chronyd: Could not step system clock"),
                ([wrong.format("0.1"), "2026-11-22T08:01:24Z Fatal error : no room"], 1,
                 "not synchronised: chronyd: Fatal error : no room"),
                (["2026-11-22T08:01:24Z Timeout reached"], 1, "not synchronised: chronyd: Timeout reached"),
                (["2026-11-22T08:01:24Z Fatal error : adjtimex(0x8001) failed"], 1,
                 "not synchronised: chronyd: Fatal error : adjtimex(0x8001) failed")]:
            with self.subTest(line):
                said = "".join(f'echo "{each}" >&2\n' for each in [*lines, "2026-11-22T08:01:24Z chronyd exiting"])
                host = Host(chronyc="exit 1", chronyd=f"{said}exit {status}")
                self.expect(host, line)
                self.assertEqual(host.calls()[-1], "chronyd -q -t 60")


class Handing(Test):
    EXPECTED = ntpd("ntpd 4.2.8p15@1.3728-o", "ntpd: time slew +0.000001s", end="exit 5")

    def test_an_ntpd_of_the_expected_kind_is_run_in_its_place(self):
        host = Host(ntpd=self.EXPECTED, chronyc=chronyc())
        done = host.run(WRAPPER, "-xgq")
        self.assertEqual((done.stdout, done.returncode), ("ntpd: time slew +0.000001s\n", 5))
        self.assertEqual(host.calls(), ["ntpd --version", "ntpd -xgq"])

    def test_every_other_use_goes_to_the_real_one(self):
        host = Host(ntpd=ntpd("ntpd ntpsec-1.2.2"), chronyc=chronyc())
        host.setup("install")
        for path in ("/usr/local/sbin:/usr/sbin:/usr/bin", "/usr/local/sbin:/usr/bin"):
            done = host.run("ntpd", "-n", "-p", "/run/a b.pid", PATH=path)
            self.assertEqual(done.stdout, "did -n -p /run/a b.pid\n")

    def test_without_a_real_one_nothing_else_is_done(self):
        host = Host(chronyc=chronyc())
        done = host.run(WRAPPER, "-gq")
        self.assertEqual(done.returncode, 1)
        self.assertIn("knows only -xgq", done.stdout)
        self.assertEqual(host.calls(), [])
        self.refuse(Host(), "no NTP daemon was found (chronyd, systemd-timesyncd that runs, ntpsec, openntpd)")


class InitScript(Test):
    VERSIONS = {"ntpsec": "ntpd ntpsec-1.2.2", "openntpd": "usage: ntpd [-dnSsv] [-f file] [-p file]", "ntpd": "ntpd 4.2.8p15"}
    OWN = 'echo "done"; case $1 in start) : >/tmp/active; sleep 100 & ;; stop) rm /tmp/active ;; status) [ -e /tmp/active ] ;; esac'

    def host(self, kind):
        return Host(ntpd=ntpd(self.VERSIONS[kind]))

    def test_controls_the_unit_where_systemd_runs(self):
        for kind, unit in [("ntpsec", "ntpsec"), ("openntpd", "openntpd"), ("ntpd", "ntpd"), ("ntpsec", "ntpd")]:
            host = self.host(kind).with_systemd(unit)
            self.assertEqual(host.control("start"), f"Starting NTP server: {unit}, done")
            self.assertEqual(host.control("stop"), f"Stopping NTP server: {unit}, done")
            calls = [call for call in host.calls() if call.startswith("systemctl st")]
            self.assertEqual(calls, [f"systemctl start {unit}", f"systemctl stop {unit}"])

    def test_says_done_only_of_what_is_so(self):
        host = self.host("ntpsec").with_systemd("ntpsec", start="echo done", stop="echo done")
        self.assertEqual(host.control("start"), "Starting NTP server: ntpsec does not start")
        (host.root / "tmp/active").touch()
        self.assertEqual(host.control("stop"), "Stopping NTP server: ntpsec does not stop")

    def test_uses_the_daemons_own_script_elsewhere(self):
        # That of a daemon that was removed may still be there.
        host = self.host("openntpd").add("etc/init.d/openntpd", self.OWN).add("etc/init.d/ntpsec", "exit 1")
        self.assertEqual(host.control("start"), "Starting NTP server: openntpd, done")
        self.assertEqual(host.control("stop"), "Stopping NTP server: openntpd, done")
        self.assertEqual({call.split()[0] for call in host.calls()}, {"ntpd", "openntpd"})

    def test_without_such_a_service_nothing_is_done(self):
        for host in (Host(), self.host("ntpsec"), Host().add("etc/init.d/ntpsec", self.OWN)):
            for action in ("start", "stop"):
                self.assertRegex(host.control(action), "^[^,]*: no service of a daemon ntpd is known here$")
        # Two requests at once take each other's ntpd for a daemon, and the second then wants it started.
        host = Host(chronyc=chronyc())
        self.assertIn("done", host.control("start"))
        self.assertNotIn("done", host.control("stop"))

    def test_knows_no_other_action(self):
        host = self.host("ntpsec").with_systemd("ntpsec")
        done = host.run(SCRIPT, "restart")
        self.assertEqual((done.returncode, done.stdout, host.calls()), (2, "", []))


class Setup(Test):
    LINKS = {"usr/local/sbin/ntpd": WRAPPER, "etc/init.d/ntp": SCRIPT}

    def links(self, host):
        return {name: os.readlink(host.root / name) for name in self.LINKS if (host.root / name).is_symlink()}

    def test_makes_links_and_takes_them_back(self):
        host = Host()
        self.assertEqual(host.setup("status").returncode, 1)
        for _ in range(2):
            self.assertEqual(host.setup("install").returncode, 0)
            self.assertEqual(self.links(host), self.LINKS)
        self.assertEqual(host.setup("status").returncode, 0)
        self.assertEqual(host.setup("remove").returncode, 0)
        self.assertEqual(self.links(host), {})
        self.assertEqual(host.setup("remove").stdout, "")

    def test_never_touches_what_it_did_not_make(self):
        for name in self.LINKS:
            for kind in ("file", "link", "dangling"):
                with self.subTest(name=name, kind=kind):
                    host, path = Host(), None
                    path = host.root / name
                    path.write_text("mine") if kind == "file" else path.symlink_to("/proc/version" if kind == "link" else "/gone")
                    before = unread(path)
                    for action in ("install", "remove", "status"):
                        done = host.setup(action)
                        self.assertEqual(unread(path), before)
                        self.assertEqual(done.returncode, 0 if action == "remove" else 1)
                        self.assertEqual("not made here" in done.stdout, action != "remove")

    def test_puts_nothing_before_an_ntpd_of_the_expected_kind(self):
        for place in ("usr/sbin/ntpd", "usr/local/sbin/ntpd"):
            host = Host().add(place, Handing.EXPECTED)
            self.assertEqual(host.setup("install").returncode, 0)
            self.assertEqual(self.links(host), {"etc/init.d/ntp": SCRIPT})
            self.assertIn(f"not needed: /{place} is", host.setup("status").stdout)

    def test_makes_the_directory_of_init_scripts_where_there_is_none(self):
        host = Host()
        (host.root / "etc/init.d").rmdir()
        (host.root / "etc/init.d").symlink_to("rc.d/init.d")
        self.assertEqual(host.setup("install").returncode, 0)
        self.assertEqual(os.readlink(host.root / "etc/rc.d/init.d/ntp"), SCRIPT)

    def test_says_what_the_running_object_manager_finds(self):
        host = Host(ntpd=ntpd("ntpd ntpsec-1.2.2"))
        host.setup("install")
        for path, found in [("/usr/local/sbin:/usr/sbin", "/usr/local/sbin/ntpd"), ("/usr/sbin:/usr/bin", "/usr/sbin/ntpd"),
                            ("/usr/bin", "no ntpd")]:
            done = host.run("/bin/sh", "-c", f"cp /usr/bin/sleep /tmp/sfcbd; PATH={path} /tmp/sfcbd 100 & "
                            f"until grep -q sfcbd /proc/$!/comm; do sleep 0.1; done; {PREFIX}/sbin/vk-ntp-setup status")
            self.assertRegex(done.stdout, rf"(?m)^sfcbd \d+: finds {found} in its PATH {path}$")

    def test_says_of_an_object_manager_whose_path_it_does_not_see_nothing_else(self):
        done = Host(ntpd=ntpd("ntpd ntpsec-1.2.2")).run(
            "/bin/sh", "-c", "cp /usr/bin/sleep /tmp/sfcbd; env -i /tmp/sfcbd 100 & "
            f"until grep -q sfcbd /proc/$!/comm; do sleep 0.1; done; {PREFIX}/sbin/vk-ntp-setup status")
        self.assertRegex(done.stdout, r"(?m)^sfcbd \d+: its PATH is not known$")

    @unittest.skipIf(os.geteuid() != 0, "takes root to become somebody else")
    def test_says_that_somebody_elses_environment_cannot_be_read(self):
        place = directory()
        place.chmod(0o755)
        MADE.chmod(0o755)
        program = shutil.copy("/usr/bin/sleep", place / "sfcbd")
        with subprocess.Popen([program, "100"]) as manager:
            done = run("setpriv", f"--reuid={NOBODY}", "--clear-groups", f"{MADE}{PREFIX}/sbin/vk-ntp-setup", "status")
            manager.kill()
        self.assertIn(f"sfcbd {manager.pid}: its PATH cannot be read; that takes root or its user\n", done.stdout)
        self.assertEqual(done.stderr, "")

    def test_refuses_unusable_arguments(self):
        for words in ([], ["install", "now"], ["upgrade"], ["--upgrade"]):
            self.assertEqual(Host().run(f"{PREFIX}/sbin/vk-ntp-setup", *words).returncode, 2)
        self.assertIn("Usage:", Host().setup("--help").stdout)
        self.assertLessEqual(widest(Host().setup("--help").stdout), 80)
        self.assertRegex(Host().setup("--version").stdout, r"^vk-ntp-setup \d")


class Package(Test):
    def test_is_executable(self):
        for program in (WRAPPER, SCRIPT):
            self.assertTrue(Path(f"{MADE}{program}").stat().st_mode & 0o111)

    def test_takes_its_links_back_when_it_is_removed_but_not_for_an_upgrade(self):
        for script, words, calls in [("prerm", ["remove"], ["vk-ntp-setup remove"]), ("prerm", ["upgrade", "2"], []),
                                     ("preun", ["0"], ["vk-ntp-setup remove"]), ("preun", ["1"], [])]:
            with self.subTest(script=script, words=words):
                host = Host(**{"vk-ntp-setup": "exit 1"})
                text = (SOURCE / "packaging/ntp" / script).read_text(encoding="utf-8")
                self.assertEqual(host.run("/bin/sh", "-c", text, script, *words).returncode, 0)
                self.assertEqual(host.calls(), calls)


if __name__ == "__main__":
    unittest.main()
