"""A vkcimd of a test's own, and asking it."""
import base64
import http.client
import os
import socket
import ssl
import subprocess
import threading

MESSAGE = """<?xml version="1.0" encoding="utf-8"?>
<CIM CIMVERSION="2.0" DTDVERSION="2.0"><MESSAGE ID="1" PROTOCOLVERSION="1.0"><SIMPLEREQ><IMETHODCALL NAME="{operation}">
<LOCALNAMESPACEPATH><NAMESPACE NAME="root"/><NAMESPACE NAME="cimv2"/></LOCALNAMESPACEPATH>
<IPARAMVALUE NAME="{parameter}">{value}</IPARAMVALUE></IMETHODCALL></SIMPLEREQ></MESSAGE></CIM>"""


class Service:
    """A running vkcimd; `urls` are those that it listens on, `log` holds its lines so far."""

    def __init__(self, program, listen, *options, environment=None):
        words = [word for url in listen for word in ("--listen", url)]
        self.process = subprocess.Popen([program, "--foreground", "--config", "/dev/null", *words, *options],
                                        env={**os.environ, "NVLOG_SINK": "none", **(environment or {})},
                                        stderr=subprocess.PIPE, text=True)
        self.urls = [self.process.stderr.readline().removeprefix("listening on ").strip() for _ in listen]
        self.log = []
        self.changed = threading.Condition()
        self.reader = threading.Thread(target=self._read, daemon=True)
        self.reader.start()

    def _read(self):
        for line in self.process.stderr:
            with self.changed:
                self.log.append(line.rstrip("\n"))
                self.changed.notify_all()

    def wait_for_line(self, *words):
        """The first line that holds all the words."""
        def found():
            return next((line for line in self.log if all(word in line for word in words)), None)
        with self.changed:
            assert self.changed.wait_for(found, 60), f"no line with {words} in {self.log}"
            return found()

    def port(self):
        return int(self.urls[0].rstrip("/").rsplit(":", 1)[1])

    def stop(self):
        self.process.terminate()
        status = self.process.wait()
        self.reader.join()
        return status


class UnixConnection(http.client.HTTPConnection):
    def __init__(self, path):
        super().__init__("localhost")
        self.path = path

    def connect(self):
        self.sock = socket.socket(socket.AF_UNIX)
        self.sock.connect(self.path)


class LoopbackConnection(http.client.HTTPSConnection):
    """To 127.0.0.1 by the name that the certificate has, which a host without /etc/hosts does not know."""

    def __init__(self, port, context):
        super().__init__("localhost", port, context=context, timeout=60)
        self.context = context

    def connect(self):
        plain = socket.create_connection(("127.0.0.1", self.port), self.timeout)
        self.sock = self.context.wrap_socket(plain, server_hostname=self.host)


def https(port, certificates, **options):
    """A connection that is not made yet."""
    context = ssl.create_default_context(cafile=certificates)
    for name, value in options.items():
        setattr(context, name, value)
    return LoopbackConnection(port, context)


def ask(connection, operation, value, parameter="ClassName", user=None):
    """HTTP status and body; `user` is (name, password)."""
    headers = {"Content-Type": "application/xml", "CIMOperation": "MethodCall", "CIMMethod": operation,
               "CIMObject": "root/cimv2"}
    if user:
        headers["Authorization"] = "Basic " + base64.b64encode(":".join(user).encode()).decode()
    connection.request("POST", "/cimom", MESSAGE.format(operation=operation, parameter=parameter, value=value), headers)
    answer = connection.getresponse()
    return answer.status, answer.read().decode()


def names(connection, class_name="VESKA_ComputerSystem", user=None):
    return ask(connection, "EnumerateInstanceNames", f'<CLASSNAME NAME="{class_name}"/>', user=user)


def delete_nothing(connection, user=None):
    """Asks for what only administrators may ask, and what changes nothing."""
    return ask(connection, "DeleteInstance", '<INSTANCENAME CLASSNAME="VESKA_ComputerSystem"><KEYBINDING NAME="Name">'
               '<KEYVALUE>nobody</KEYVALUE></KEYBINDING></INSTANCENAME>', "InstanceName", user)


def run_all(tests):
    """Runs functions whose names and first lines say what has to hold. Returns the exit status."""
    failed = 0
    for test in tests:
        try:
            test()
            print(f"{test.__name__}: ok", flush=True)
        except (AssertionError, OSError, http.client.HTTPException) as error:
            failed += 1
            print(f"{test.__name__}: FAILED: {type(error).__name__} {error}", flush=True)
    return 1 if failed else 0
