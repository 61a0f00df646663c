"""How the provider is made known to OpenPegasus. What was registered before is kept until the new one serves."""

import contextlib
import tempfile
from pathlib import Path

from cimserver import INTEROP, STOPPED, CimServer, without_state
from manager import NEWEST_CLASS
from owner import Failure


class OpenPegasus(CimServer):
    @contextlib.contextmanager
    def reached(self):
        """A server that is down is started for as long as this takes."""
        with contextlib.ExitStack() as end:
            if self.modules() is None:
                self.run("cimserver", done="started the server for the registration")
                end.callback(self.run_at_last, "cimserver", "-s", done="stopped the server again")
                if not self.options.dry_run and not self.comes_true(lambda: self.modules() is not None):
                    raise Failure("the server does not answer after its start")
            yield

    def prepare(self, link):
        if self.modules() is not None:
            code, text = self.ask("cimcli", "gc", "-n", self.product.namespace, NEWEST_CLASS)
            self.require(link, None if not self.command["cimcli"] else "" if code else text, text if code else "")

    def disable(self):
        """A provider that is busy is asked again; a module that refuses otherwise can still be removed."""
        command = ["cimprovider", "-d", *self.module]
        if self.state() in (None, STOPPED):
            return
        if self.options.dry_run:
            self.run(*command)
            return

        def idle():
            self.answer = self.ask(*command)
            return self.answer[0] == 0 or "busy" not in self.answer[1]
        if not self.comes_true(idle):
            raise Failure(f"{self.what} cannot be disabled", self.answer[1])
        if self.answer[0]:
            self.say(f"{self.what} was not disabled: {''.join(self.answer[1].splitlines()[-1:])}")

    def clear(self, known):
        """Takes module and classes away, those that refer to others first."""
        self.disable()
        if known.state:
            self.run("cimprovider", "-r", *self.module, done=f"removed {self.what}")
        for name in reversed(known.classes):
            self.run("cimcli", "dc", "-n", self.product.namespace, name)
        if known.classes and not self.options.dry_run:
            self.say(f"removed the classes from {self.product.namespace}")

    def declare(self, directory):
        namespace = self.product.namespace
        self.run("cimmof", "-n", namespace, f"{directory}/vk-baseserver.mof", done=f"declared the classes in {namespace}")
        self.run("cimmof", "-n", INTEROP, f"{directory}/vk-baseserver-registration.mof", done=f"registered {self.what}")

    def settle(self, state):
        """A module that the administrator stopped stays so. Any other has to answer a request now."""
        if state == STOPPED:
            self.disable()
            self.say(f"{self.what} {self.starting()}; it stays so")
        elif self.command["cimcli"] and not self.options.dry_run:
            name = next(iter(self.ours))
            code, text = self.ask("cimcli", "ni", "-n", self.product.namespace, name)
            if code or name not in text:
                raise Failure("the provider does not answer through the server", text or "nothing was returned")

    def register(self):
        known = self.known()
        if not known.state or self.difference(known):
            known = self.replace(known)
        else:
            if known.state == STOPPED or self.noted.get("library") == self.library():
                self.say(f"{self.what} is registered already")
            else:
                self.disable()
                self.run("cimprovider", "-e", *self.module, done="had the new library taken into use")
            self.settle(known.state)
        return self.mark(known)

    def replace(self, older):
        """What is registered cannot be changed, only taken away and made anew; if that fails, the older is."""
        if older.state and not self.command["cimcli"]:
            raise Failure("cimcli is not there, without which the older classes cannot be replaced; they stay in force")
        if not self.options.dry_run:
            self.disable()
        try:
            self.clear(older)
            self.declare(self.product.share)
            # cimmof also succeeds where it leaves what is there already as it is.
            known = self.known()
            flaw = self.command["cimcli"] and not self.options.dry_run and self.difference(known)
            if flaw and (flaw.startswith("without") or known[1:] == older[1:]):
                raise Failure(f"the server took the files, and shows the module {flaw}")
            self.settle(older.state)
            return known
        except BaseException:
            self.restore(older)
            raise

    def restore(self, older):
        try:
            self.clear(self.known())
            if not older.state:
                return
            with tempfile.TemporaryDirectory() as directory:
                for kind, texts in ("", older.classes.values()), ("-registration", map(without_state, older.instances)):
                    Path(f"{directory}/vk-baseserver{kind}.mof").write_text("\n\n".join(texts), encoding="utf-8")
                self.declare(directory)
            if older.state == STOPPED:
                self.disable()
            self.say("the older registration is back in force")
        except Failure as failure:
            self.fail(f"the older registration is not back: {failure}")

    def unregister(self):
        with self.reached():
            self.clear(self.known())
        if not self.command["cimcli"]:
            namespace = self.product.namespace
            self.say(f"cimcli is not there: the classes stay declared in {namespace}, where they do no harm")

    def by_hand(self):
        return "These commands take it back:\n    " + "; ".join([
            *(f"export {name}={value}" for name, value in self.own_home.items()), "cimserver",
            *(f"cimprovider -{way} {' '.join(self.module)}" for way in "dr"),
            *(f"cimcli dc -n {self.product.namespace} {name}" for name in reversed(self.ours))])
