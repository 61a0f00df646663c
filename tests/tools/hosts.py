"""Directories that hold the files of a host, for the tests of vk-host-snapshot."""

import json
import os
import struct
import uuid

from support import BUILD, directory, run

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
    root = directory()
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
    target = directory() / "copy"
    return target, run(SNAPSHOT, "--root", root, *words, target)


def instances(root, name):
    done = run(VKCIM, "--format", "json", "instances", name,
               env={"VK_INSTRUMENTATION_ROOT": str(root), "NVLOG_SINK": "none", "PATH": "/usr/bin:/bin"})
    return [{k: v["value"] for k, v in result["properties"].items()} for result in json.loads(done.stdout)["results"]]


def properties(root, name):
    return instances(root, name)[0]
