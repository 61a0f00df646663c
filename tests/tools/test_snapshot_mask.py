"""vk-host-snapshot masks: a copy gives the same answers but for what names the machine."""

import os
import struct
import unittest

from hosts import SYSTEM_UUID, instances, make_host, properties, structure, table, take


class Masked(unittest.TestCase):
    SECRETS = [b"CZJ1234567", b"CHAS0042", b"ASSET-77", b"8F3A2B1C", b"12345678", SYSTEM_UUID.bytes_le, SYSTEM_UUID.bytes,
               str(SYSTEM_UUID).encode(), str(SYSTEM_UUID).upper().encode(), b"0123456789abcdef0123456789abcdef"]

    def test_holds_nothing_that_names_the_machine(self):
        target, done = take(make_host())
        self.assertEqual(done.returncode, 0, done.stderr)
        for path in target.rglob("*"):
            if path.is_file():
                for secret in self.SECRETS:
                    self.assertNotIn(secret, path.read_bytes(), path)

    def test_keeps_lengths_shapes_and_checksums(self):
        root = make_host()
        target, _ = take(root)
        directory_of_tables = "sys/firmware/dmi/tables"
        before, after = ((r / directory_of_tables / "DMI").read_bytes() for r in (root, target))
        self.assertEqual(len(before), len(after))
        point = (target / directory_of_tables / "smbios_entry_point").read_bytes()
        self.assertEqual(sum(point[:31]) & 0xFF, 0)
        self.assertEqual(sum(point[16:31]) & 0xFF, 0)
        self.assertRegex(properties(target, "VESKA_PhysicalPackage")["SerialNumber"], r"^[A-Z]{4}\d{4}$")

    def test_tells_the_same_but_for_serial_numbers_and_uuids(self):
        root = make_host()
        target, _ = take(root)
        for name, changed in [("VESKA_ComputerSystem", {"UUID", "OtherIdentifyingInfo"}),
                              ("VESKA_PhysicalPackage", {"Tag", "SerialNumber"})]:
            before, after = properties(root, name), properties(target, name)
            self.assertEqual({k for k in before if before[k] != after[k]}, changed)
            self.assertEqual(before.keys(), after.keys())

    def test_masks_the_same_by_the_same_in_every_source(self):
        for version, data in [((2, 7), table()), ((2, 5), table(uuid_bytes=SYSTEM_UUID.bytes))]:
            target, _ = take(make_host(data, version))
            answer = properties(target, "VESKA_ComputerSystem")["UUID"]
            in_file = (target / "sys/class/dmi/id/product_uuid").read_text(encoding="ascii").strip()
            self.assertEqual(in_file, answer.upper(), version)
            serial = (target / "sys/class/dmi/id/product_serial").read_text(encoding="ascii").strip()
            self.assertIn(serial.encode(), (target / "sys/firmware/dmi/tables/DMI").read_bytes())

    def test_leaves_what_says_nothing(self):
        data = table(chassis_serial="To Be Filled By O.E.M.", system_serial="0123456789", uuid_bytes=b"\xff" * 16)
        root = make_host(data, **{"sys/class/dmi/id/product_serial": b"0123456789\n"})
        target, _ = take(root)
        answer = properties(target, "VESKA_PhysicalPackage")
        self.assertNotIn("SerialNumber", answer)
        copy = (target / "sys/firmware/dmi/tables/DMI").read_bytes()
        self.assertIn(b"To Be Filled By O.E.M.", copy)
        self.assertIn(b"0123456789", copy)
        self.assertIn(b"\xff" * 16, copy)

    def test_survives_damaged_tables(self):
        whole = table()
        for cut in range(0, len(whole), 7):
            target, done = take(make_host(whole[:cut]))
            self.assertEqual(done.returncode, 0, done.stderr)
            self.assertEqual((target / "sys/firmware/dmi/tables/DMI").stat().st_size, cut)

    def test_writes_another_host_name_on_request(self):
        target, _ = take(make_host(), "--host-name", "other")
        self.assertEqual((target / "etc/hostname").read_text(encoding="ascii"), "other\n")


class Tables(unittest.TestCase):
    """What of the SMBIOS tables gets through: only what is known to be the same on many machines."""

    TABLE = "sys/firmware/dmi/tables/DMI"

    def masked(self, data):
        """The masked copy of a table. The provider must answer the same from it, but for serial numbers and UUID."""
        root = make_host(data)
        target, done = take(root)
        self.assertEqual(done.returncode, 0, done.stderr)
        for name, own in [("VESKA_ComputerSystem", {"UUID", "OtherIdentifyingInfo"}),
                          ("VESKA_PhysicalPackage", {"Tag", "SerialNumber"})]:
            before, after = ([{k: v if k not in own else None for k, v in one.items()} for one in instances(r, name)]
                             for r in (root, target))
            self.assertEqual(before, after)
        copy = (target / self.TABLE).read_bytes()
        self.assertEqual(len(copy), len(data))
        return copy

    def put_before_end(self, *added):
        whole = table()
        return whole[:-6] + b"".join(added) + whole[-6:]

    def emptied(self, added, *hidden):
        """Of the structure added, header and length alone are kept."""
        data = self.put_before_end(added)
        copy = self.masked(data)
        at = data.index(added)
        length = added[1]
        self.assertEqual(copy[at:at + length], added[:4] + bytes(length - 4))
        for text in hidden:
            self.assertIn(text, data)
            self.assertNotIn(text, copy)
        strings, kept = added[length:], copy[at + length:at + len(added)]
        self.assertEqual(kept, bytes(b and ord("x") for b in strings))

    def test_management_controller_host_interface_is_emptied(self):
        service, host, address = bytes(range(0x81, 0x91)), b"bmc-node7.example.net", bytes([192, 0, 2, 77])
        usb = struct.pack("<BHHB", 4, 0x046B, 0xFFB0, 14) + "USB-9911".encode("utf-16le")
        record = service + bytes([1, 1]) + address.ljust(16, b"\0") + bytes(16) + bytes([len(host)]) + host
        body = bytes([0x40, len(usb)]) + usb + bytes([1, 4, len(record)]) + record
        self.emptied(structure(42, 42, body, "HOSTIF-5521"), service, host, address, "USB-9911".encode("utf-16le"),
                     b"HOSTIF-5521")

    def test_additional_information_is_emptied(self):
        self.emptied(structure(40, 40, bytes([1, 6, 1, 0, 5, 1, 0x5A]), "Serial ADD-3377"), b"ADD-3377")

    def test_battery_is_emptied(self):
        body = bytearray(0x1A - 4)
        body[0x07 - 4], body[0x10 - 4:0x12 - 4] = 1, b"\xD7\xC4"
        self.emptied(structure(22, 22, bytes(body), "BAT-6612"), b"\xD7\xC4", b"BAT-6612")

    def test_a_kind_that_nobody_knows_is_emptied(self):
        for kind in (4, 11, 17, 39, 43, 45, 99, 126, 128, 255):
            self.emptied(structure(kind, 9, b"\x01SECRET-1", "SECRET-2", "SECRET-3"), b"SECRET-1", b"SECRET-2", b"SECRET-3")

    def test_strings_behind_an_empty_one_are_emptied(self):
        added = struct.pack("<BBH", 40, 5, 9) + b"\x02" + b"\0SECRET-2\0\0"
        self.emptied(added, b"SECRET-2")

    def test_firmware_is_kept(self):
        firmware = structure(0, 9, bytes([1, 2, 0, 0xE0, 3, 0xFF]) + bytes(range(8, 22)), "Vendor", "1.2.3", "01/02/2020")
        self.assertIn(firmware, self.masked(self.put_before_end(firmware)))

    def test_of_the_system_and_chassis_only_what_is_known_is_kept(self):
        system = bytes([1, 2, 3, 4]) + SYSTEM_UUID.bytes_le + bytes([6, 5, 6]) + b"BEYOND-1"
        chassis = bytes([1, 23, 2, 3, 4, 3, 3, 3, 2]) + b"OEM!" + bytes([2, 1, 1, 3]) + b"CON" + bytes([5]) + b"BEYOND-2"
        data = b"".join([
            structure(1, 1, system, "Example", "RX200", "Rev B", "SYS-0001", "SKU-42", "Family 9", "LOOSE-1"),
            structure(3, 2, chassis, "Example", "V7", "CHA-0002", "TAG-0003", "SKU-43", "LOOSE-2"), structure(127, 3, b"")])
        copy = self.masked(data)
        for secret in (b"SYS-0001", b"Family 9", b"BEYOND", b"LOOSE", b"OEM!", b"CON", b"CHA-0002", b"TAG-0003",
                       SYSTEM_UUID.bytes_le):
            self.assertIn(secret, data)
            self.assertNotIn(secret, copy)
        for kept in (b"Example\0RX200\0Rev B\0", b"SKU-42\0", b"Example\0V7\0", b"SKU-43\0"):
            self.assertIn(kept, copy)

    def test_of_the_base_board_manufacturer_and_product_are_kept(self):
        board = structure(2, 2, bytes([1, 2, 3, 4, 5, 9, 6]) + b"\x03\0\x0a", "ASRockRack", "X570D4U", "1.02", "BSN-0006",
                          "TAG-0007", "Slot 9")
        system = bytes([1, 1, 0, 2]) + SYSTEM_UUID.bytes_le + bytes([6, 0, 0])
        data = b"".join([structure(1, 1, system, "To Be Filled By O.E.M.", "SYS-0001"), board, structure(127, 3, b"")])
        copy = self.masked(data)
        self.assertIn(b"ASRockRack\0X570D4U\0", copy)
        for secret in (b"1.02", b"BSN-0006", b"TAG-0007", b"Slot 9", b"SYS-0001"):
            self.assertIn(secret, data)
            self.assertNotIn(secret, copy)

    def test_several_chassis_stay_in_their_order(self):
        others = [structure(3, 20 + n, bytes([1, kind, 2, 3, 0, 3, 3, 3, 2]), f"Maker {n}", f"V{n}", f"CHASSIS-SN-{n}00{n}")
                  for n, kind in enumerate((7, 29, 3, 23))]
        data = self.put_before_end(*others)
        copy = self.masked(data)
        self.assertEqual(len(instances(make_host(data), "VESKA_PhysicalPackage")), 5)
        for n in range(4):
            self.assertNotIn(f"SN-{n}00{n}".encode(), copy)

    def test_what_stands_behind_the_end_is_zeroed(self):
        for end in (structure(127, 7, b""), b"\x7f\x00\x01\x02", b"\x7f\xff\x01\x02"):
            data = table()[:-6] + end + structure(1, 8, b"\x01SECRET-1", "SECRET-2") + b"SECRET-3"
            copy = self.masked(data)
            at = len(table()) - 6
            self.assertEqual(copy[at:], end[:4] + bytes(len(data) - at - 4))

    def test_what_is_broken_is_hidden_and_stays_broken_alike(self):
        for broken in (b"\x03\x02\x01\0SECRET-1\0\0" + b"SECRET-2" * 9, b"\0\0\0\0SECRET-1", b"\x03\xff\x01\0SECRET-1\0\0",
                       b"\x03\x05\x01\0\x01SECRET-1\0SECRET-2\0", b"\x01\xAA\xBB"):
            data = table()[:-6] + broken
            copy = self.masked(data)
            self.assertNotIn(b"SECRET", copy)
            self.assertNotIn(b"\xAA\xBB", copy[-2:])
            at = len(table()) - 6
            self.assertEqual(copy[at:at + 2], broken[:2])

    def test_zeros_behind_the_structures_stay(self):
        data = table()[:-6] + bytes(20)
        self.assertEqual(self.masked(data)[-20:], bytes(20))


class Texts(unittest.TestCase):
    def of_file(self, name, content):
        target, done = take(make_host(**{name: content}))
        self.assertEqual(done.returncode, 0, done.stderr)
        return (target / name).read_bytes()

    def test_serial_numbers_that_begin_like_fillers_are_masked(self):
        for serial in ("System 0042-XYZ9", "Chassis 77-ABC", "Not 0815-QRS", "To be 4711-TUV", "No Asset Tag 12345",
                       "Base Board 9987-A", "To be filled 55667", "A", "To be set by 88776655"):
            masked = self.of_file("sys/class/dmi/id/chassis_serial", serial.encode() + b"\n").decode()
            self.assertNotEqual(masked, serial + "\n")
            self.assertEqual(len(masked), len(serial) + 1)
            secret = serial.split()[-1]
            self.assertNotIn(secret, masked)
            root = make_host(table(chassis_serial=serial))
            target, _ = take(root)
            serials = [properties(r, "VESKA_PhysicalPackage")["SerialNumber"] for r in (root, target)]
            self.assertEqual(serials[0], serial)
            self.assertNotIn(secret, serials[1])

    def test_fillers_stay(self):
        for text in ("System Serial Number", "Chassis  Serial Number", "Not Specified", "not applicable", "NO ASSET TAG",
                     "To Be Filled By O.E.M.", "To be filled by O E M", "To be set", "Default string", "0", "0000000", "...",
                     "xx-xx", "Standard", "123456789", "  None "):
            self.assertEqual(self.of_file("sys/class/dmi/id/chassis_serial", text.encode() + b"\n"), text.encode() + b"\n")
            root = make_host(table(text, "None"), **{"sys/class/dmi/id/product_serial": b"None\n"})
            self.assertNotIn("SerialNumber", properties(root, "VESKA_PhysicalPackage"))

    def test_what_stands_behind_a_filler_is_hidden(self):
        text = "To be filled by O.E.M. SN-778899"
        root = make_host(table(text, "None"))
        (root / "sys/class/dmi/id/product_serial").unlink()
        target, _ = take(root)
        copy = (target / "sys/firmware/dmi/tables/DMI").read_bytes()
        self.assertNotIn(b"778899", copy)
        for each in (root, target):
            self.assertNotIn("SerialNumber", properties(each, "VESKA_PhysicalPackage"))

    def test_a_uuid_in_another_shape_is_masked(self):
        for text in (f"urn:uuid:{SYSTEM_UUID}", f"{{{SYSTEM_UUID}}}", SYSTEM_UUID.hex, "4c4c4544-0043-3010"):
            masked = self.of_file("sys/class/dmi/id/product_uuid", text.encode() + b"\n")
            self.assertNotIn(b"4c4c4544", masked)
            self.assertEqual(len(masked), len(text) + 1)

    def test_sysinfo_keeps_what_many_machines_have(self):
        lines = ["Manufacturer:         Example", "Type:                 2964", "Model:                701 N63",
                 "Sequence Code:        00000000000AB1C7", "Plant:                02", "LPAR Number:          17",
                 "LPAR Name:            PROD0815", "LPAR Extended Name:   Payroll production",
                 "LPAR UUID:            82038f2a-1344-aaf7-1a85-2a7250be2076", "VM00 Name:            LINUX042",
                 "VM00 Control Program: ZSPECIAL 6.4", "VM00 Extended Name:   guest-of-acme",
                 f"VM00 UUID:            {SYSTEM_UUID}", "a line of its own", ""]
        text = "\n".join(lines)
        root = make_host(**{"proc/sysinfo": text.encode(), "proc/device-tree/compatible": b"x AB1C7 00000000000AB1C7\0"})
        for name in ("sys/firmware/dmi/tables/DMI", "sys/class/dmi/id/product_serial"):
            (root / name).unlink()
        target, done = take(root)
        self.assertEqual(done.returncode, 0, done.stderr)
        copy = (target / "proc/sysinfo").read_text(encoding="ascii")
        for secret in ("AB1C7", "PROD0815", "Payroll", "82038f2a", "2a7250be2076", "LINUX042", "ZSPECIAL", "acme",
                       str(SYSTEM_UUID), "a line of its own"):
            self.assertIn(secret, text)
            self.assertNotIn(secret, copy)
        masked = copy.split("\n")
        self.assertEqual(masked[:3], lines[:3])
        self.assertEqual([line.rstrip() for line in masked[4:6]], ["Plant:", "LPAR Number:"])
        self.assertEqual([line.split(":")[0] for line in masked[:-2]], [line.split(":")[0] for line in lines[:-2]])
        self.assertRegex(masked[3], r"^Sequence Code:        \d{11}[A-Z]{2}\d[A-Z]\d$")
        self.assertRegex(masked[8], r"^LPAR UUID:            [0-9a-f-]{36}$")
        uuid_in_firmware = (target / "sys/class/dmi/id/product_uuid").read_text(encoding="ascii").strip()
        self.assertEqual(masked[12].split()[-1], uuid_in_firmware.lower())
        self.assertNotIn(b"00000000000AB1C7", (target / "proc/device-tree/compatible").read_bytes())
        own = {"OtherIdentifyingInfo", "UUID"}
        before, after = (properties(r, "VESKA_ComputerSystem") for r in (root, target))
        self.assertLessEqual({k for k in before if before[k] != after.get(k)}, own)
        self.assertEqual(before.keys(), after.keys())


@unittest.skipUnless(os.environ.get("VK_TEST_HOSTS"), "VK_TEST_HOSTS names no snapshots of real machines")
class RealMachines(unittest.TestCase):
    def test_masked_ones_tell_the_same_but_for_serial_numbers_and_uuids(self):
        for name in sorted(os.listdir(os.environ["VK_TEST_HOSTS"])):
            with self.subTest(name):
                root = os.path.join(os.environ["VK_TEST_HOSTS"], name)
                target, done = take(root)
                self.assertEqual(done.returncode, 0, done.stderr)
                for kind, own in [("VESKA_ComputerSystem", {"UUID", "OtherIdentifyingInfo"}),
                                  ("VESKA_PhysicalPackage", {"Tag", "SerialNumber"})]:
                    before, after = (instances(r, kind) for r in (root, target))
                    self.assertEqual([one.keys() for one in before], [one.keys() for one in after])
                    changed = {k for one, other in zip(before, after) for k in one if one[k] != other[k]}
                    self.assertLessEqual(changed, own)


if __name__ == "__main__":
    unittest.main()
