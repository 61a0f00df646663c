#!/usr/bin/python3 -IS
"""The commands of OpenPegasus and SFCB, as far as a registration uses them: copied under their names into a root, where
they record what is asked of them, answer as the real ones do, and remember it below state. What state/fail holds fails.
When the classes are declared, the registration gets the signal of state/signal."""

import os
import re
import sys
from pathlib import Path

here = Path(sys.argv[0]).absolute()
root = next(directory for directory in here.parents if (directory / "state").is_dir())
state, (name, *words) = root / "state", [here.name, *sys.argv[1:]]
MODULES = root / "var/lib/Pegasus/repository/root#PG_InterOp/instances/PG_ProviderModule.instances"
SFCB = root / (state / "sfcb-home").read_text().strip() if (state / "sfcb-home").exists() else root
PORT = "   0: 0100007F:1764 00000000:0000 0A 00000000:00000000\n"


def get(what, default=""):
    return (state / what).read_text(encoding="utf-8") if (state / what).exists() else default


def end(code, text="", error=""):
    print(text, end="\n" if text else "")
    print(error, end="\n" if error else "", file=sys.stderr)
    sys.exit(code)


def classes_of(mof):
    return re.findall(r"^(\[.*?^class (\w+) : (\w+).*?^\};)", mof, re.M | re.S)


def as_shown(text):
    """Breaks texts at other places than the file does, and adds what is inherited."""
    text = re.sub(r'"\s*\n\s*"', "", re.sub(r"^\s*//.*\n", "", text, flags=re.M)).replace("'", "\\'")
    text = re.sub(r'"([^"\n]{40})([^"\n]+)"', r'"\1"\n        "\2"', text).replace('("', '( "').replace('")', '" )')
    return text.replace('[Override ( "Status" )', '[Override ( "Status" ), Deprecated { "CIM_X.OperationalStatus" }')


def declare(mof, file):
    """Classes that are there stay as they are; a superclass that is not there ends it half-way."""
    (state / "classes").mkdir(exist_ok=True)
    for text, declared, superclass in classes_of(mof):
        if (state / "classes" / declared).exists():
            print(f"Warning:  Class {declared} already exists in the repository", file=sys.stderr)
        elif superclass not in get("schema").split() and not (state / "classes" / superclass).exists():
            end(1, error=f"Parsing error: parse error: {file}: CIM_ERR_INVALID_SUPERCLASS: {superclass}")
        else:
            (state / "classes" / declared).write_text(as_shown(text), encoding="utf-8")


def register(mof):
    for block in re.findall(r"^instance of .*?^\};", mof, re.M | re.S):
        key = re.search(r'CapabilityID = "(.*)"', block) or re.search(r' Name = "(.*)"', block)
        file = state / "instances" / f"{block.split()[2]}.{key[1]}"
        file.parent.mkdir(exist_ok=True)
        if file.exists():
            print("Warning: the instance already exists.\nIn this implementation, that means it cannot be changed.", file=sys.stderr)
        else:
            file.write_text(block + "\n", encoding="utf-8")
        if block.split()[2] == "PG_ProviderModule" and not (state / "module").exists():
            (state / "module").write_text(f"{key[1]} OK")
            MODULES.write_text(f"<VALUE>{key[1]}</VALUE>\n")


def cimprovider():
    module, status = (get("module") or " ").split(" ")
    if words[0] == "-l":
        end(0, "MODULE                       STATUS\nIPProviderModule             OK " + (f"\n{module:<28} {status} " if module else ""))
    if words[2] != module:
        end(1, error="Specified provider module was not registered.")
    if words[0] == "-d" and status == "Stopped":
        end(0, "Disabling provider module...\nProvider module already disabled.")
    busy = int(get("busy", "0"))
    if words[0] == "-d" and busy:
        (state / "busy").write_text(str(busy - 1))
        end(1, "Disabling provider module...\nFailed to disable provider module: Provider is busy.")
    if words[0] == "-r":
        (state / "module").unlink()
        for file in state.glob("instances/*"):
            file.unlink()
        (state / "instances").rmdir()
        MODULES.write_text("")
    else:
        (state / "module").write_text(f"{module} {'OK' if words[0] == '-e' else 'Stopped'}")


def cimmof():
    if words[0] != "-n":
        end(254, error=f"{here}: Unknown value specified for option -u.\n{here}: Use '--help' to obtain command syntax.")
    mof = Path(words[2]).read_text(encoding="utf-8")
    if words[1] == "root/PG_InterOp":
        register(mof)
    else:
        declare(mof, words[2])
        if get("signal"):
            os.kill(os.getppid(), int(get("signal")))


def cimcli():
    operation, asked = words[0], words[3]
    missing = f"cimcli CIMException:  Cmd= {operation} Object= {asked} Code= 6\nCIM_ERR_NOT_FOUND: {asked}"
    file = state / "classes" / asked
    if operation == "ei":
        end(0, "\n".join(f"// path= {asked}\n\n{f.read_text(encoding='utf-8')}" for f in sorted(state.glob(f"instances/{asked}.*"))))
    if operation == "gc" and asked.startswith("CIM_") and asked in get("schema").split():
        end(0, f'    [Version ( "{get("version", "2.41.0")}" )]\nclass {asked} : CIM_X\n{{\n}};')
    if not file.exists():
        end(6, error=missing)
    if operation == "dc":
        if get("deaf") != "dc":
            file.unlink()
        end(0)
    if operation == "gc":
        end(0, file.read_text(encoding="utf-8"))
    looks_in = root / get("home", "x") / "lib" if provider_dir() == "lib" else Path(str(root) + provider_dir())
    link = looks_in / "libvknabaseserverprofileprovider.so"
    serves = not get("mute") and link.exists() or (state / "any-directory").exists()
    if not get("module").endswith(" OK") or not serves:
        end(1, error=f"CIM_ERR_FAILED: cannot load library, error: {link}: cannot open shared object file")
    end(0, f'{asked}.CreationClassName="{asked}",Name="vm"')


def provider_dir():
    return get("providerDir", "/usr/lib64/Pegasus/providers")


def cimconfig():
    planned = "-p" in words
    if (state / "up").exists() or (planned and (state / "providerDir").exists()):
        value = get("providerDir-as-said") or provider_dir()
        end(0, f"{'Planned' if planned else 'Current'} value: {value}")
    end(1, f"{'Planned' if planned else 'Current'} value can not be determined because the CIM server is not running.")


def cimserver():
    if words == ["-s"]:
        (state / "up").unlink()
    elif get("starts") != "never":
        (state / "up").touch()


def sfcb_process(up):
    (root / "proc/42").mkdir(parents=True, exist_ok=True)
    (root / "proc/net").mkdir(exist_ok=True)
    (root / "proc/42/stat").write_text("42 (sfcbd) S 1 42 42" if up else "42 (other) S 1 42 42")
    (root / "proc/net/tcp").write_text(PORT if up else "")


def is_up():
    return "(sfcbd)" in (root / "proc/42/stat").read_text()


def sfcbstage():
    if words == ["-h"]:
        end(0, f"-e \t-s specify staging directory [/{SFCB.relative_to(root)}/var/lib/sfcb/stage]".replace("/./", "/"))
    stage = SFCB / "var/lib/sfcb/stage"
    regs, mofs = stage / "regs", stage / "mofs" / words[1]
    if name == "sfcbunstage":
        for file in [regs / words[3], *(mofs / word for word in words[4:])]:
            file.unlink(missing_ok=True)
        return
    regs.mkdir(parents=True, exist_ok=True)
    mofs.mkdir(parents=True, exist_ok=True)
    (regs / Path(words[3]).name).write_bytes(Path(words[3]).read_bytes())
    staged = mofs / Path(words[4]).name
    if os.system(f"sfcbmofpp '{words[4]}' >'{staged}'"):
        end(1, error="Error: could not copy schema files")


def sfcbmofpp():
    print(re.sub(r"^ *//.*\n", "", Path(words[0]).read_text(encoding="utf-8"), flags=re.M), end="")


def sfcbrepos():
    home = "/" + str(SFCB.relative_to(root)) if SFCB != root else ""
    if words == ["-h"]:
        end(0, f"-e \t-s specify staging directory [{home}/var/lib/sfcb/stage]\n-e \t-r specify repository directory "
               f"[{home}/var/lib/sfcb/registration]\n-e \t-c specify directory containing CIM Schema MOFs [{home}/usr/share/sfcb/CIM]")
    registration, stage = SFCB / "var/lib/sfcb/registration", SFCB / "var/lib/sfcb/stage"
    os.system(f"rm -rf '{registration}'")  # the older one is put aside first, and is of no use then
    (registration / "repository/root/cimv2").mkdir(parents=True)
    (registration / "providerRegister").write_text("[CIM_Default]\n" + "".join(f.read_text() for f in sorted(stage.glob("regs/*.reg"))))
    names = set(get("schema").split())
    for file in sorted(stage.glob("mofs/root/cimv2/*.mof")):
        for _, declared, superclass in classes_of(file.read_text(encoding="utf-8")):
            if superclass not in names:
                end(1, "Failed compiling the MOF files.")
            names.add(declared)
    (registration / "repository/root/cimv2/classSchemas").write_text("\0".join(sorted(names - set(get("schema").split()))) + "\0")


def systemctl():
    if not (root / "run/systemd/system").is_dir():
        end(1, error="System has not been booted with systemd as init system (PID 1). Can't operate.")
    if words[0] == "is-active":
        sys.exit(0 if is_up() else 3)
    sfcb_process(words[0] == "start")


def sfcb():
    """The generic init script."""
    if words == ["status"]:
        end(0, "Checking SFCB status: " + ("42" if is_up() else "stopped."))
    if words == ["stop"] and not is_up():
        end(1, "Shutting down sfcb: failed.")
    sfcb_process(words == ["start"] and get("starts") != "never")


with open(root / "calls", "a", encoding="utf-8") as log:
    log.write(f"{name} {' '.join(words)}\n")
if get("fail").strip() and f"{name} {' '.join(words)}".startswith(get("fail").strip()):
    end(1, error="it cannot be done")
if name in ("cimprovider", "cimmof", "cimcli") and not (state / "up").exists():
    end(1, error="The CIM server may not be running.")
{"sfcbunstage": sfcbstage}.get(name, globals().get(name))()
