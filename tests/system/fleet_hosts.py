"""Hosts for the tests of many: copies of the machines that VK_TEST_HOSTS names, simulated ones, and one that says little."""

import json
import os
import shutil
from pathlib import Path

SOURCE = Path(__file__).resolve().parents[2]
EXAMPLE = json.loads((SOURCE / "docs/examples/rack-server.json").read_text(encoding="utf-8"))
OK, PREDICTED, DEGRADED, UNKNOWN = 1, 20, 21, 0
SILENT = 3  # the number of the host without firmware
STATUSES = [PREDICTED, DEGRADED, UNKNOWN, OK]
MODELS = ["RX200", "RX300", "TX100", "BX400"]


def simulated(file, number, status, model=None):
    tree = json.loads(json.dumps(EXAMPLE))
    computer, chassis = (node["properties"] for node in tree["nodes"])
    for node in tree["nodes"]:
        node["status"] = status
    model = model or MODELS[number % len(MODELS)]
    computer.update({"108": f"node{number}", "39": model, "50": f"CZ{number:06}", "64": f"4c4c4544-0043-3010-8052-{number:012x}"})
    chassis.update({"39": model, "50": f"CZ{number:06}"})
    file.write_text(json.dumps(tree), encoding="utf-8")
    return {"VK_INSTRUMENTATION_TREE": str(file)}


def silent(directory, name):
    """A snapshot of a host of which nothing is known but its name."""
    (directory / "etc").mkdir(parents=True)
    (directory / "etc/hostname").write_text(f"{name}\n", encoding="ascii")
    return {"VK_INSTRUMENTATION_ROOT": str(directory)}


def many(directory, count):
    """Name and environment of each host."""
    hosts = {}
    machines = os.environ.get("VK_TEST_HOSTS")
    for machine in sorted(Path(machines).iterdir()) if machines else []:
        shutil.copytree(machine, directory / machine.name, symlinks=True)
        hosts[machine.name] = {"VK_INSTRUMENTATION_ROOT": str(directory / machine.name)}
    for number in range(count - len(hosts)):
        name = f"node{number}"
        hosts[name] = silent(directory / name, name) if number == SILENT else \
            simulated(directory / f"{name}.json", number, STATUSES[min(number, len(STATUSES) - 1)])
    return dict(list(hosts.items())[-count:])
