"""vk-host-snapshot --mask: a masked copy tells the same but for what names the machine."""

import os
import unittest

from hosts import SYSTEM_UUID, instances, make_host, properties, table, take


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
                for kind, own in [("VESKA_ComputerSystem", {"UUID", "OtherIdentifyingInfo"}),
                                  ("VESKA_PhysicalPackage", {"Tag", "SerialNumber"})]:
                    before, after = (instances(r, kind) for r in (root, target))
                    self.assertEqual([one.keys() for one in before], [one.keys() for one in after])
                    changed = {k for one, other in zip(before, after) for k in one if one[k] != other[k]}
                    self.assertLessEqual(changed, own)


if __name__ == "__main__":
    unittest.main()
