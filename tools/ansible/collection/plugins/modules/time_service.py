"""Sets the time service of a host through the base server provider."""

DOCUMENTATION = r"""
module: time_service
short_description: Sets a host's automatic daylight saving, or its time
description:
  - Asks C(vkcim) on the host, and changes only what differs. What it says has changed is what reads differently afterwards.
options:
  automatic_dst_adjustment:
    description:
      - Whether local time follows daylight saving. C(false) replaces the time zone by one without, and remembers it;
        C(true) brings it back, and fails where none is remembered. Only the attempt shows whether one is. So in check
        mode C(true) warns of that, and says that it would change.
    type: bool
  time:
    description:
      - The time, a CIM date-time such as C(20261121060000.000000+060). ManageTime sets the clock and the time zone's offset
        to it, and has the host synchronise with its time server.
    type: str
  tolerance:
    description: How many seconds the clock may differ from C(time) and is left alone.
    type: int
    default: 2
  vkcim:
    description: The command.
    type: str
    default: vkcim
attributes:
  check_mode:
    support: full
author:
  - VK base server provider
"""

EXAMPLES = r"""
- name: No daylight saving on servers
  vk.baseserver.time_service:
    automatic_dst_adjustment: false
"""

RETURN = r"""
before:
  description: What the host said before. What it does not know is missing.
  returned: where the host answers
  type: dict
  sample: {"automatic_dst_adjustment": true, "time": "20261121060000.123456+060", "offset_minutes": 60}
after:
  description: What it says now; in check mode as before.
  returned: where the host answers, and is not refused beforehand
  type: dict
"""

import datetime
import json
import re
from time import monotonic

from ansible.module_utils.basic import AnsibleModule

SERVICE = "VESKA_TimeService"
COMPUTER = "VESKA_ComputerSystem"
TIME = re.compile(r"(\d{14})\.(\d{6})([+-]\d{3})")
NAMES = {"automatic_dst_adjustment": "time_service_AutomaticDSTAdjustment", "time": "time_service_time",
         "offset_minutes": "time_service_offset_minutes"}


def instant(text):
    """The moment that a CIM date-time names, and its offset in minutes."""
    match = TIME.fullmatch(text) if isinstance(text, str) else None
    if match is None:
        raise ValueError(f"{text!r} is no CIM date-time")
    digits, fraction, offset = match.groups()
    minutes = int(offset)
    local = datetime.datetime.strptime(digits + fraction, "%Y%m%d%H%M%S%f")
    try:
        return local - datetime.timedelta(minutes=minutes), minutes
    except OverflowError:
        raise ValueError(f"{text!r} is before the year 1 or after 9999") from None


def known(name, value):
    """Whether a fact is what it should be: a time that is no date-time says nothing."""
    try:
        return name != "time" or instant(value) is not None
    except ValueError:
        return False


class Host:
    def __init__(self, module):
        self.module = module
        self.result = {"changed": False}
        self.notes = []

    def fail(self, message):
        self.module.fail_json(msg=message, **self.result)

    def ask(self, *words):
        """The command's exit status, output and complaint."""
        command = self.module.params["vkcim"]
        try:
            status, output, error = self.module.run_command([command, *words], handle_exceptions=False)
        except OSError as error:
            self.fail(f"{command}: {error.strerror}")
        return status, output, error.strip().splitlines()[-1] if error.strip() else f"vkcim ended with {status}"

    def state(self):
        status, output, complaint = self.ask("report", "--format", "facts")
        if status != 0:
            self.fail(complaint)
        try:
            facts = dict(json.loads(output))
        except (TypeError, ValueError):
            self.fail("what vkcim prints is no object")
        self.notes = facts.get("notes", [])
        return {name: facts[fact] for name, fact in NAMES.items() if fact in facts and known(name, facts[fact])}

    def adjust(self, wanted):
        status, _, complaint = self.ask("modify", SERVICE, f"AutomaticDSTAdjustment={str(wanted).lower()}")
        return None if status == 0 else complaint

    def set_time(self, wanted):
        status, output, complaint = self.ask(
            "--format", "json", "invoke", SERVICE, "ManageTime", "GetRequest=false", f"TimeData={wanted}",
            f"ManagedElement={COMPUTER}")
        if status != 0:
            return complaint
        try:
            value = json.loads(output)["returnValue"]["value"]
        except (KeyError, TypeError, ValueError):
            return "ManageTime returned nothing"
        return None if value == 0 else f"ManageTime returned {value}"


def is_near(state, wanted, tolerance):
    """Whether the host's clock and offset are the wanted ones."""
    if "time" not in state:
        return False
    now, then = instant(state["time"])[0], instant(wanted)
    return abs((now - then[0]).total_seconds()) <= tolerance and state.get("offset_minutes") == then[1]


def differs(before, after, seconds, tolerance):
    """Whether the host reads differently, but for the seconds that went by."""
    times = [state.get("time") for state in (before, after)]
    steady = [{name: value for name, value in state.items() if name != "time"} for state in (before, after)]
    if steady[0] != steady[1] or times.count(None) == 1:
        return True
    if None in times:
        return False
    moved = (instant(times[1])[0] - instant(times[0])[0]).total_seconds()
    return abs(moved - seconds) > tolerance


def main():
    module = AnsibleModule(
        argument_spec={"automatic_dst_adjustment": {"type": "bool"}, "time": {"type": "str"},
                       "tolerance": {"type": "int", "default": 2}, "vkcim": {"type": "str", "default": "vkcim"}},
        required_one_of=[["automatic_dst_adjustment", "time"]],
        # An offset is a time zone without daylight saving.
        mutually_exclusive=[["automatic_dst_adjustment", "time"]], supports_check_mode=True)
    dst, time, tolerance = (module.params[name] for name in ("automatic_dst_adjustment", "time", "tolerance"))
    host = Host(module)
    if tolerance < 0:
        host.fail(f"tolerance: {tolerance} is less than 0")
    try:
        offset = instant(time)[1] if time is not None else None
    except ValueError as error:
        host.fail(f"time: {error}")
    before = host.result["before"] = host.state()

    def has_it(state):
        return state.get("automatic_dst_adjustment") == dst if time is None else is_near(state, time, tolerance)

    # A host that does not say what is to be set cannot have it set, in check mode or out of it.
    needed = "automatic_dst_adjustment" if time is None else "offset_minutes"
    if needed not in before:
        host.fail(host.notes[0] if host.notes else f"the host does not say its {needed}")
    if has_it(before) or module.check_mode:
        if dst and not has_it(before):
            module.warn("Brings back the time zone that was replaced, if one is remembered.")
        module.exit_json(changed=not has_it(before), before=before, after=before)
    started = monotonic()
    problem = host.adjust(dst) if time is None else host.set_time(time)
    host.result["changed"] = True  # Should the host not be asked again, it may be another one already.
    after = host.state()
    # ManageTime may set the clock and then find no time server: both count, each for itself.
    result = {"changed": differs(before, after, monotonic() - started, tolerance), "before": before, "after": after}
    # Which time it is then is the time server's word.
    done = after.get("offset_minutes") == offset if time is not None else has_it(after)
    if problem is not None or not done:
        module.fail_json(msg=problem or "the host reads as before", **result)
    module.exit_json(**result)


if __name__ == "__main__":
    main()
