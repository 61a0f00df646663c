"""How the provider is made known to OpenPegasus. What was registered before is kept until the new registration serves."""

import contextlib
import tempfile

from cimserver import INTEROP, STOPPED, CimServer
from host import Failure, indented
from mof import NEWEST_CLASS, require_schema, without_state


class OpenPegasus(CimServer):
    @contextlib.contextmanager
    def running(self):
        """A server that is down is started for as long as this takes."""
        if self.modules() is not None:
            yield
            return
        self.run("cimserver", done="started the server for the registration")
        try:
            if not self.host.dry_run and not self.host.comes_true(lambda: self.modules() is not None):
                raise Failure("the server does not answer after its start")
            yield
        finally:
            try:
                self.run("cimserver", "-s", done="stopped the server again")
            except Failure as failure:  # does not hide why the rest failed
                self.host.fail(failure)

    def disable(self):
        """A provider that is busy is asked again; a module that refuses otherwise can still be removed."""
        if self.host.dry_run:
            self.run("cimprovider", "-d", "-m", self.product.module)
            return
        answers = []

        def idle():
            answers.append(self.ask("cimprovider", "-d", "-m", self.product.module))
            return answers[-1][0] == 0 or "busy" not in answers[-1][1]
        done, text = self.host.comes_true(idle), answers[-1][1]
        if not done:
            raise Failure(indented(f"the module {self.product.module} cannot be disabled", text))
        if answers[-1][0]:
            self.host.say(f"the module {self.product.module} was not disabled: {text.splitlines()[-1] if text else ''}")

    def clear(self, classes):
        """Takes module and classes away, those that refer to others first."""
        state = self.state()
        if state:
            if state != STOPPED:
                self.disable()
            self.run("cimprovider", "-r", "-m", self.product.module, done=f"removed the module {self.product.module}")
        for name in reversed(classes):
            self.run("cimcli", "dc", "-n", self.product.namespace, name)
        if classes and not self.host.dry_run:
            self.host.say(f"removed the classes from {self.product.namespace}")

    def declare(self, folder):
        self.run("cimmof", "-n", self.product.namespace, f"{folder}/vk-baseserver.mof", done=f"declared the classes in {self.product.namespace}")
        self.run("cimmof", "-n", INTEROP, f"{folder}/vk-baseserver-registration.mof", done=f"registered the module {self.product.module}")

    def settle(self, state):
        """A module that the administrator stopped stays so. Any other has to answer a request now."""
        name = next(iter(self.ours))
        if state == STOPPED:
            if self.state() != STOPPED:
                self.disable()
            self.host.say(f"the module {self.product.module} {self.starting()}; it stays so")
        elif self.command["cimcli"] and not self.host.dry_run:
            code, text = self.ask("cimcli", "ni", "-n", self.product.namespace, name)
            if code or name not in text:
                raise Failure(indented("the provider does not answer through the server", text or "nothing was returned"))

    def starting(self):
        return f"was stopped by the administrator: cimprovider -e -m {self.product.module} starts it"

    def replace(self, state, older):
        """What is registered cannot be changed, only taken away and made anew; if that fails, the older is made anew."""
        if state and not self.command["cimcli"]:
            raise Failure("cimcli is not there, without which the older classes cannot be replaced; they stay in force")
        if state and state != STOPPED and not self.host.dry_run:
            self.disable()
        try:
            self.clear(older[0])
            self.declare(self.product.share)
            # That cimmof succeeds says little: what is there already it leaves as it is.
            there = self.known()
            flaw = self.command["cimcli"] and not self.host.dry_run and self.flaw(*there)
            if flaw and (flaw.startswith("without") or there == older):
                raise Failure(f"the server took the files, and shows the module {flaw}")
            self.settle(state)
            return there
        except BaseException:
            self.restore(state, *older)
            raise

    def restore(self, state, classes, registration):
        try:
            self.clear(self.known()[0])
            if not state:
                return
            with tempfile.TemporaryDirectory() as folder:
                for name, texts in ("vk-baseserver.mof", classes.values()), ("vk-baseserver-registration.mof", map(without_state, registration)):
                    with open(f"{folder}/{name}", "w", encoding="utf-8") as file:
                        file.write("\n\n".join(texts))
                self.declare(folder)
            if state == STOPPED:
                self.disable()
            self.host.say("the older registration is back in force")
        except Failure as failure:
            self.host.fail(f"the older registration is not back: {failure}")

    def install(self):
        with self.running():
            link = self.link()
            if not self.would_be_started():
                self.need_link(link)
                if self.command["cimcli"]:
                    code, text = self.ask("cimcli", "gc", "-n", self.product.namespace, NEWEST_CLASS)
                    require_schema(*("", text) if code else (text,))
            state, replaced = self.state(), None
            self.note(link)
            try:
                if link:
                    replaced = self.host.put_link(self.name, link, self.product.library)
                there = self.known()
                if not state or self.flaw(*there):
                    there = self.replace(state, there)
                elif state == STOPPED or self.noted.get("library") == self.product.identity():
                    self.host.say(f"the module {self.product.module} is registered already")
                    self.settle(state)
                else:
                    self.disable()
                    self.run("cimprovider", "-e", "-m", self.product.module, done="had the new library taken into use")
                    self.settle(state)
            except BaseException:
                self.undo(link, replaced, state or self.state())
                raise
            self.host.note(self.name, shown=self.shown(*there), library=self.product.identity())

    def remove(self):
        link, up = self.link() or self.noted.get("library-link"), self.modules() is not None
        if not (self.state() or self.known()[0] if up else self.noted or self.on_disk()):
            self.host.say(f"the module {self.product.module} is not registered")
        else:
            try:
                with self.running():
                    self.clear(self.known()[0])
                if not self.command["cimcli"]:
                    self.host.say(f"cimcli is not there: the classes stay declared in {self.product.namespace}, where they do no harm")
            except Failure as failure:
                raise Failure(f"{failure}\nThe provider stays registered. These commands take it back:\n    {self.by_hand(link)}") from failure
        self.host.take_back(self.name, link)

    def by_hand(self, link):
        return "; ".join([*(f"export {name}={value}" for name, value in self.own_home.items()), "cimserver",
                          *(f"cimprovider -{way} -m {self.product.module}" for way in "dr"),
                          *(f"cimcli dc -n {self.product.namespace} {name}" for name in reversed(self.ours)), f"rm -f {link}"])

    def status(self):
        modules = self.modules()
        state = (modules or {}).get(self.product.module)
        known, flaw = state and "registered", ""
        if modules is None:
            disk = self.on_disk()
            known = "registered" if disk else "registered, as far as can be told" if disk is None and self.noted else ""
        elif state:
            flaw = self.flaw(*self.known()) or (self.starting() if state == STOPPED else "")
        running = "not running" if modules is None else "running"
        return self.say_status(f"found ({self.command['cimserver']}), {running}; the module {self.product.module}", known, flaw,
                               self.link() or self.noted.get("library-link"))
