"""kvtag serve as a child process, on the private broker and the reference
tag service of python/support/tagworld.py."""

import json
import os
import re
import subprocess
import sys
import threading
import urllib.error
import urllib.request
from pathlib import Path

import pytest

REPOSITORY = Path(__file__).resolve().parents[3]
sys.path.insert(0, str(REPOSITORY / "python" / "support"))

import tagworld  # noqa: E402

KVTAG = os.environ.get("KVTAG", str(REPOSITORY / "build" / "tools" / "kvtag" / "kvtag"))
READY = re.compile(r"^kvtag serve: listening on (http://\S+/)$")
START_TIMEOUT_S = 30


def kvtag(*args, stdin=""):
    """Runs kvtag; its standard output, or a failure with what it said."""
    run = subprocess.run([KVTAG, *args], input=stdin, capture_output=True, text=True, timeout=60)
    assert run.returncode == 0, f"kvtag {' '.join(args)}: {run.returncode}\n{run.stderr}"
    return run.stdout


def request(url, method="GET", body=None, headers=None):
    """(status, headers, parsed JSON or text) of one request, errors included."""
    data = body.encode() if isinstance(body, str) else body
    call = urllib.request.Request(url, data=data, method=method, headers=headers or {})
    try:
        with urllib.request.urlopen(call, timeout=30) as answer:
            status, got_headers, raw = answer.status, answer.headers, answer.read()
    except urllib.error.HTTPError as error:
        status, got_headers, raw = error.code, error.headers, error.read()
    text = raw.decode()
    is_json = got_headers.get("Content-Type", "").startswith("application/json")
    return status, got_headers, json.loads(text) if is_json else text


class Served:
    """One kvtag serve on a free loopback port, stopped by stop()."""

    def __init__(self, *options):
        self.output = []
        self.url = None
        self.process = subprocess.Popen(
            [KVTAG, "serve", "--listen", "127.0.0.1:0", *options], stdout=subprocess.PIPE,
            stderr=subprocess.STDOUT, text=True)
        ready = threading.Event()

        def drain():
            for line in self.process.stdout:
                self.output.append(line)
                match = READY.match(line.strip())
                if match:
                    self.url = match.group(1)
                    ready.set()
            ready.set()

        threading.Thread(target=drain, daemon=True).start()
        if not ready.wait(START_TIMEOUT_S) or self.url is None:
            self.stop()
            raise RuntimeError("kvtag serve did not start:\n" + "".join(self.output))
        self.token = None
        if "--allow-write" in options:
            page = request(self.url)[2]
            self.token = re.search(r'name="kvtag-token" content="([0-9a-f]+)"', page).group(1)

    def api(self, path, method="GET", body=None, headers=None):
        return request(self.url + path.lstrip("/"), method, body, headers)

    def stop(self):
        if self.process.poll() is None:
            self.process.terminate()
            try:
                self.process.wait(30)
            except subprocess.TimeoutExpired:
                self.process.kill()
                self.process.wait()


@pytest.fixture(scope="session")
def world():
    with tagworld.TagWorld(tagworld.default_tagservice(),
                           exchange=f"kvveldra.kvtag-serve.{os.getpid()}") as started:
        yield started


@pytest.fixture(scope="module")
def readonly(world):
    served = Served()
    yield served
    served.stop()
    assert served.process.returncode == 0, "".join(served.output)


@pytest.fixture(scope="module")
def writable(world):
    served = Served("--allow-write")
    yield served
    served.stop()
    assert served.process.returncode == 0, "".join(served.output)
