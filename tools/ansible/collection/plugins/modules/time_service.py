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
        C(true) brings it back, and fails where none is remembered.
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
  returned: always
  type: dict
  sample: {"automatic_dst_adjustment": true, "time": "20261121060000.123456+060", "offset_minutes": 60}
after:
  description: What it says now; in check mode as before.
  returned: always
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
    match = TIME.fullmatch(text or "")
    if match is None:
        raise ValueError(f"{text!r} is no CIM date-time")
    digits, fraction, offset = match.groups()
    minutes = int(offset)
    local = datetime.datetime.strptime(digits + fraction, "%Y%m%d%H%M%S%f")
    return local - datetime.timedelta(minutes=minutes), minutes


class Host:
    def __init__(self, module):
        self.module = module

    def ask(self, *words):
        """The command's exit status, output and complaint."""
        status, output, error = self.module.run_command([self.module.params["vkcim"], *words], handle_exceptions=False)
        return status, output, error.strip().splitlines()[-1] if error.strip() else f"vkcim ended with {status}"

    def state(self):
        try:
            status, output, complaint = self.ask("report", "--format", "facts")
        except OSError as error:
            self.module.fail_json(msg=f"{self.module.params['vkcim']}: {error.strerror}")
        if status != 0:
            self.module.fail_json(msg=complaint)
        facts = json.loads(output)
        return {name: facts[fact] for name, fact in NAMES.items() if fact in facts}

    def adjust(self, wanted):
        status, _, complaint = self.ask("modify", SERVICE, f"AutomaticDSTAdjustment={str(wanted).lower()}")
        return None if status == 0 else complaint

    def set_time(self, wanted):
        status, output, complaint = self.ask(
            "--format", "json", "invoke", SERVICE, "ManageTime", "GetRequest=false", f"TimeData={wanted}",
            f"ManagedElement={COMPUTER}")
        if status != 0:
            return complaint
        answer = json.loads(output)["returnValue"]
        return None if answer and answer["value"] == 0 else f"ManageTime returned {answer and answer['value']}"


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
    if time is not None:
        try:
            instant(time)
        except ValueError as error:
            module.fail_json(msg=f"time: {error}")
    host = Host(module)
    before = host.state()

    def has_it(state):
        return state.get("automatic_dst_adjustment") == dst if time is None else is_near(state, time, tolerance)

    if has_it(before) or module.check_mode:
        module.exit_json(changed=not has_it(before), before=before, after=before)
    started = monotonic()
    problem = host.adjust(dst) if time is None else host.set_time(time)
    after = host.state()
    # ManageTime may set the clock and then find no time server: both count, each for itself.
    result = {"changed": differs(before, after, monotonic() - started, tolerance), "before": before, "after": after}
    # Which time it is then is the time server's word.
    done = after.get("offset_minutes") == instant(time)[1] if time else has_it(after)
    if problem is not None or not done:
        module.fail_json(msg=problem or "the host reads as before", **result)
    module.exit_json(**result)


if __name__ == "__main__":
    main()
