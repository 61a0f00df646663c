"""What the tests of vk-provider-register share: an installation of the provider, and running the command from it."""

import os
import re
import unittest

from support import directory, install, run

PREFIX = directory() / "installed"
install(PREFIX, component="provider")
SHARE = PREFIX / "share/vk-baseserver"
MODULE = "VKBaseServerModule"
CLASSES = re.findall(r"^class (\w+)", (SHARE / "vk-baseserver.mof").read_text(encoding="utf-8"), re.M)


class Register(unittest.TestCase):
    def setUp(self):
        self.root = directory()

    def register(self, *words, prefix=PREFIX, status=0, **more):
        env = {"PATH": "/usr/sbin:/usr/bin:/sbin:/bin", "VK_REGISTER_PAUSE": "0", "VK_REGISTER_ROOT": str(self.root), **more}
        done = run(prefix / "sbin/vk-provider-register", *words, env=env)
        self.assertEqual(done.returncode, status, done.stdout + done.stderr)
        return done

    def cimconfig_link(self):
        found = [p for p in self.root.rglob("*") if p.name == "cimconfig" and p.is_symlink()]
        return (str(found[0].relative_to(self.root)), os.readlink(found[0])) if found else None
