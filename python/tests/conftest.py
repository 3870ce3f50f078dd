"""The Python module's tests run against a private broker and the reference
tag service (python/support/tagworld.py), one of each for the session."""

import sys
from pathlib import Path

import pytest

sys.path.insert(0, str(Path(__file__).resolve().parents[1] / "support"))

import tagworld  # noqa: E402

import kvveldra  # noqa: E402


@pytest.fixture(scope="session")
def world():
    with tagworld.TagWorld(tagworld.default_tagservice()) as started:
        yield started


@pytest.fixture
def client(world):
    with kvveldra.Client() as opened:
        yield opened


@pytest.fixture
def prefix(request):
    """A path prefix of the test's own."""
    return "py." + request.node.name.replace("[", ".").replace("]", "")
