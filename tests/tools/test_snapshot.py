"""vk-host-snapshot: what is copied, and that a masked copy tells the same but for what names the machine."""

import json
import os
import struct
import unittest
import uuid

from support import BUILD, folder, run

SNAPSHOT = BUILD / "installed/vk-host-snapshot"
VKCIM = BUILD / "bin/vkcim"
SYSTEM_UUID = uuid.UUID("4c4c4544-0043-3010-8052-b4c04f564231")


def structure(kind, handle, body, *strings):
    return struct.pack("<BBH", kind, 4 + len(body), handle) + body + (
        b"".join(s.encode() + b"\0" for s in strings) + b"\0" if strings else b"\0\0")


def table(chassis_serial="CHAS0042", system_serial="CZJ1234567", uuid_bytes=SYSTEM_UUID.bytes_le):
    system = bytes([1, 2, 0, 3]) + uuid_bytes + bytes([6, 0, 0])
    chassis = bytes([1, 23, 0, 2, 3, 3, 3, 3, 2]) + bytes(4) + bytes([0, 0, 0, 0])
    memory = bytearray(0x1C - 4)
    memory[0x18 - 4], memory[0x19 - 4] = 1, 2
    return b"".join([structure(1, 1, system, "Example", "RX200", system_serial),
                     structure(3, 3, chassis, "Example", chassis_serial, "ASSET-77"),
                     structure(11, 4, bytes([1]), f"service tag {system_serial}"),
                     structure(17, 5, bytes(memory), "8F3A2B1C", "To Be Filled By O.E.M."),
                     structure(221, 6, b"\x01hidden " + system_serial.encode(), "OEM 12345678"),
                     structure(127, 7, b"")])


def entry_point(length, version=(2, 7)):
    inner = struct.pack("<5sBHIHB", b"_DMI_", 0, length, 0, 6, 0x27)
    inner = inner[:5] + bytes([-sum(inner) & 0xFF]) + inner[6:]
    outer = struct.pack("<4sBBBBHB5s", b"_SM_", 0, 31, *version, 200, 0, bytes(5)) + inner
    return outer[:4] + bytes([-sum(outer) & 0xFF]) + outer[5:]


def make_host(data=None, version=(2, 7), **files):
    root = folder()
    data = table() if data is None else data
    contents = {"sys/firmware/dmi/tables/DMI": data,
                "sys/firmware/dmi/tables/smbios_entry_point": entry_point(len(data), version),
                "sys/class/dmi/id/product_serial": b"CZJ1234567\n",
                "sys/class/dmi/id/product_uuid": f"{SYSTEM_UUID}\n".upper().encode(),
                "etc/hostname": b"node7\n", "etc/machine-id": b"0123456789abcdef0123456789abcdef\n",
                "etc/machine-info": b'PRIMARY_OWNER_NAME="Operations"\n', "usr/share/zoneinfo/Europe/Berlin": b"TZif2...",
                "sys/devices/system/edac/mc/mc0/ue_count": b"0\n", **files}
    for name, content in contents.items():
        (root / name).parent.mkdir(parents=True, exist_ok=True)
        (root / name).write_bytes(content)
    os.symlink("/usr/share/zoneinfo/Europe/Berlin", root / "etc/localtime")
    return root


def take(root, *words):
    target = folder() / "copy"
    return target, run(SNAPSHOT, "--root", root, *words, target)


def properties(root, name):
    done = run(VKCIM, "--format", "json", "instances", name,
               env={"VK_INSTRUMENTATION_ROOT": str(root), "NVLOG_SINK": "none", "PATH": "/usr/bin:/bin"})
    return {k: v["value"] for k, v in json.loads(done.stdout)["results"][0]["properties"].items()}


class Plain(unittest.TestCase):
    def test_copies_what_the_provider_reads(self):
        root = make_host()
        target, done = take(root)
        self.assertEqual(done.returncode, 0, done.stderr)
        for name in ("sys/firmware/dmi/tables/DMI", "sys/firmware/dmi/tables/smbios_entry_point", "etc/machine-id",
                     "sys/class/dmi/id/product_uuid", "etc/hostname", "usr/share/zoneinfo/Europe/Berlin",
                     "sys/devices/system/edac/mc/mc0/ue_count"):
            self.assertEqual((target / name).read_bytes(), (root / name).read_bytes(), name)
        self.assertEqual(os.readlink(target / "etc/localtime"), "/usr/share/zoneinfo/Europe/Berlin")
        self.assertEqual((target / "proc/sys/kernel/arch").read_text(encoding="ascii").strip(), os.uname().machine)
        self.assertEqual(target.stat().st_mode & 0o777, 0o700)

    def test_tells_the_same_as_the_host(self):
        root = make_host()
        target, _ = take(root)
        for name in ("VESKA_ComputerSystem", "VESKA_PhysicalPackage"):
            self.assertEqual(properties(target, name), properties(root, name))

    def test_a_folder_that_holds_something_is_refused(self):
        root = make_host()
        self.assertEqual(run(SNAPSHOT, "--root", root, root).returncode, 2)
        self.assertEqual(run(SNAPSHOT).returncode, 2)

    @unittest.skipIf(os.geteuid() != 0, "takes root to become somebody else")
    def test_what_cannot_be_read_is_named(self):
        root = make_host()
        root.chmod(0o755)
        target = folder()
        os.chown(target, 65534, 65534)
        (root / "sys/firmware/dmi/tables/DMI").chmod(0o400)
        done = run("setpriv", "--reuid=65534", "--regid=65534", "--clear-groups", SNAPSHOT, "--root", root, target)
        if "vk-host-snapshot" not in done.stderr:
            self.skipTest(f"the program cannot be run as another user here: {done.stderr}")
        self.assertEqual(done.returncode, 1)
        self.assertIn("/sys/firmware/dmi/tables/DMI: Permission denied", done.stderr)


class Masked(unittest.TestCase):
    SECRETS = [b"CZJ1234567", b"CHAS0042", b"ASSET-77", b"8F3A2B1C", b"12345678", SYSTEM_UUID.bytes_le, SYSTEM_UUID.bytes,
               str(SYSTEM_UUID).encode(), str(SYSTEM_UUID).upper().encode(), b"0123456789abcdef0123456789abcdef"]

    def test_holds_nothing_that_names_the_machine(self):
        target, done = take(make_host(), "--mask")
        self.assertEqual(done.returncode, 0, done.stderr)
        for path in target.rglob("*"):
            if path.is_file():
                for secret in self.SECRETS:
                    self.assertNotIn(secret, path.read_bytes(), path)

    def test_keeps_lengths_shapes_and_checksums(self):
        root = make_host()
        target, _ = take(root, "--mask")
        folder_of_tables = "sys/firmware/dmi/tables"
        before, after = ((r / folder_of_tables / "DMI").read_bytes() for r in (root, target))
        self.assertEqual(len(before), len(after))
        point = (target / folder_of_tables / "smbios_entry_point").read_bytes()
        self.assertEqual(sum(point[:31]) & 0xFF, 0)
        self.assertEqual(sum(point[16:31]) & 0xFF, 0)
        self.assertRegex(properties(target, "VESKA_PhysicalPackage")["SerialNumber"], r"^[A-Z]{4}\d{4}$")

    def test_tells_the_same_but_for_serial_numbers_and_uuids(self):
        root = make_host()
        target, _ = take(root, "--mask")
        for name, changed in [("VESKA_ComputerSystem", {"UUID", "OtherIdentifyingInfo"}),
                              ("VESKA_PhysicalPackage", {"Tag", "SerialNumber"})]:
            before, after = properties(root, name), properties(target, name)
            self.assertEqual({k for k in before if before[k] != after[k]}, changed)
            self.assertEqual(before.keys(), after.keys())

    def test_masks_the_same_by_the_same_in_every_source(self):
        for version, data in [((2, 7), table()), ((2, 5), table(uuid_bytes=SYSTEM_UUID.bytes))]:
            target, _ = take(make_host(data, version), "--mask")
            told = properties(target, "VESKA_ComputerSystem")["UUID"]
            in_file = (target / "sys/class/dmi/id/product_uuid").read_text(encoding="ascii").strip()
            self.assertEqual(in_file, told.upper(), version)
            serial = (target / "sys/class/dmi/id/product_serial").read_text(encoding="ascii").strip()
            self.assertIn(serial.encode(), (target / "sys/firmware/dmi/tables/DMI").read_bytes())

    def test_leaves_what_says_nothing(self):
        data = table(chassis_serial="To Be Filled By O.E.M.", system_serial="0123456789", uuid_bytes=b"\xff" * 16)
        root = make_host(data, **{"sys/class/dmi/id/product_serial": b"0123456789\n"})
        target, _ = take(root, "--mask")
        told = properties(target, "VESKA_PhysicalPackage")
        self.assertNotIn("SerialNumber", told)
        copy = (target / "sys/firmware/dmi/tables/DMI").read_bytes()
        self.assertIn(b"To Be Filled By O.E.M.", copy)
        self.assertIn(b"0123456789", copy)
        self.assertIn(b"\xff" * 16, copy)

    def test_survives_damaged_tables(self):
        whole = table()
        for cut in range(0, len(whole), 7):
            target, done = take(make_host(whole[:cut]), "--mask")
            self.assertEqual(done.returncode, 0, done.stderr)
            self.assertEqual((target / "sys/firmware/dmi/tables/DMI").stat().st_size, cut)

    def test_writes_another_host_name_on_request(self):
        target, _ = take(make_host(), "--host-name", "other")
        self.assertEqual((target / "etc/hostname").read_text(encoding="ascii"), "other\n")


@unittest.skipUnless(os.environ.get("VK_TEST_HOSTS"), "VK_TEST_HOSTS names no snapshots of real machines")
class RealMachines(unittest.TestCase):
    def test_masked_ones_tell_the_same_but_for_serial_numbers_and_uuids(self):
        for name in sorted(os.listdir(os.environ["VK_TEST_HOSTS"])):
            with self.subTest(name):
                root = os.path.join(os.environ["VK_TEST_HOSTS"], name)
                target, done = take(root, "--mask")
                self.assertEqual(done.returncode, 0, done.stderr)
                before, after = (properties(r, "VESKA_ComputerSystem") for r in (root, target))
                changed = {k for k in before if before[k] != after.get(k)}
                self.assertLessEqual(changed, {"UUID", "OtherIdentifyingInfo"})
                self.assertEqual(before.keys(), after.keys())


if __name__ == "__main__":
    unittest.main()
