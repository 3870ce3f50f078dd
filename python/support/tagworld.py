"""A private RabbitMQ node, a data root that names it, and kvveldra-tagservice
on it: what the Python module's tests and benchmark run against.

The node is the one whose env file KVVELDRA_BROKER_ENV names (as ctest's
broker fixture and scripts/bench.sh start it), else one started here with
tests/integration/broker/broker.sh and stopped at the end.
"""

import os
import shutil
import socket
import subprocess
import tempfile
import threading
from pathlib import Path

REPOSITORY = Path(__file__).resolve().parents[2]
BROKER_SCRIPT = REPOSITORY / "tests" / "integration" / "broker" / "broker.sh"
READY_LINE = "kvveldra-tagservice ready"
START_TIMEOUT_S = 30
STOP_TIMEOUT_S = 30


def read_env_file(path):
    """The KEY='value' lines that broker.sh writes, as a dict."""
    settings = {}
    for line in Path(path).read_text().splitlines():
        key, sep, value = line.partition("=")
        if sep:
            settings[key.strip()] = value.strip().strip("'")
    return settings


def configuration(config_id, exchange, host, port, user, password):
    """The JSON of one broker configuration file, as scripts/demo.sh writes it."""
    return (
        f'{{"Id":"{config_id}","DisplayName":"python tests","ExchangeName":"{exchange}",'
        f'"Host":"{host}","Port":{port},"User":"{user}","Password":"{password}","UseTls":false}}\n'
    )


def free_port():
    """A loopback port that nothing listens on now."""
    with socket.socket() as probe:
        probe.bind(("127.0.0.1", 0))
        return probe.getsockname()[1]


class TagWorld:
    """The broker, the data root (VELDRA_DATA_DIR of this process from start
    on) and the tag service. Besides veldra_master and veldra_localhost the
    root has the configuration "unreachable", a port where nothing listens."""

    def __init__(self, tagservice, exchange=None):
        self.tagservice = tagservice
        self.exchange = exchange or f"kvveldra.python.{os.getpid()}"
        self.work = Path(tempfile.mkdtemp(prefix="kvveldra-python."))
        self.data_root = self.work / "data"
        self.broker_env = os.environ.get("KVVELDRA_BROKER_ENV", "")
        self.own_broker = not (self.broker_env and Path(self.broker_env).is_file())
        self.service = None
        self.output = []

    def __enter__(self):
        try:
            self.start()
        except BaseException:
            self.stop()
            raise
        return self

    def __exit__(self, *exc):
        self.stop()

    def start(self):
        if self.own_broker:
            self.broker_env = str(self.work / "broker.env")
            subprocess.run(["bash", str(BROKER_SCRIPT), "start", self.broker_env], check=True)
        broker = read_env_file(self.broker_env)
        folder = self.data_root / "VeldraConfigurations"
        folder.mkdir(parents=True)
        address = (broker["BROKER_HOST"], broker["BROKER_AMQP_PORT"], broker["BROKER_USER"],
                   broker["BROKER_PASSWORD"])
        for config_id in ("veldra_master", "veldra_localhost"):
            (folder / f"{config_id}.json").write_text(
                configuration(config_id, self.exchange, *address))
        (folder / "unreachable.json").write_text(
            configuration("unreachable", self.exchange, "127.0.0.1", free_port(), *address[2:]))
        os.environ["VELDRA_DATA_DIR"] = str(self.data_root)
        self._start_service()

    def _start_service(self):
        self.service = subprocess.Popen(
            [self.tagservice], stdout=subprocess.PIPE, stderr=subprocess.STDOUT, text=True,
            env=dict(os.environ))
        ready = threading.Event()

        def drain():
            for line in self.service.stdout:
                self.output.append(line)
                if line.startswith(READY_LINE):
                    ready.set()
            ready.set()  # ended: the wait below need not run out

        threading.Thread(target=drain, daemon=True).start()
        if not ready.wait(START_TIMEOUT_S) or self.service.poll() is not None:
            raise RuntimeError("kvveldra-tagservice did not start:\n" + "".join(self.output))

    def stop(self):
        if self.service is not None and self.service.poll() is None:
            self.service.terminate()
            try:
                self.service.wait(STOP_TIMEOUT_S)
            except subprocess.TimeoutExpired:
                self.service.kill()
                self.service.wait()
        if self.own_broker and Path(self.broker_env).is_file():
            subprocess.run(["bash", str(BROKER_SCRIPT), "stop", self.broker_env], check=False)
        shutil.rmtree(self.work, ignore_errors=True)


def default_tagservice():
    """KVVELDRA_TAGSERVICE, else the service of the build tree build/."""
    return os.environ.get(
        "KVVELDRA_TAGSERVICE",
        str(REPOSITORY / "build" / "tools" / "tagservice" / "kvveldra-tagservice"))
