"""The JSON API of kvtag serve, by plain HTTP."""

import json
import socket
import time
import urllib.parse

import pytest
from conftest import kvtag

TAGS = [f"serve.api.t{i:02d}" for i in range(12)]


@pytest.fixture(scope="module", autouse=True)
def tags(world):
    kvtag("write", "--stdin", "--type", "double",
          stdin="".join(f"{path} {i}.5\n" for i, path in enumerate(TAGS)))


def listing(served, pattern, skip, take):
    query = urllib.parse.urlencode({"pattern": pattern, "skip": skip, "take": take})
    status, _, body = served.api("/api/list?" + query)
    assert status == 200, body
    return body


def test_list_pages_through_the_matches_of_a_wildcard(readonly):
    pages = [listing(readonly, "serve.api.*", skip, 5) for skip in (0, 5, 10)]
    assert [page["total"] for page in pages] == [12, 12, 12]
    assert [len(page["tags"]) for page in pages] == [5, 5, 2]
    seen = [tag["path"] for page in pages for tag in page["tags"]]
    assert sorted(seen) == TAGS
    assert {tag["type"] for page in pages for tag in page["tags"]} == {"double"}
    narrow = listing(readonly, "serve.api.t1*", 0, 100)
    assert sorted(tag["path"] for tag in narrow["tags"]) == TAGS[10:]
    assert listing(readonly, "serve.nothing.*", 0, 100) == {
        "total": 0, "skip": 0, "take": 100, "tags": []}


def test_read_by_get_and_post_names_the_missing_tags(readonly):
    status, _, by_get = readonly.api("/api/read?path=serve.api.t03&path=serve.api.none")
    assert status == 200, by_get
    assert [(v["path"], v["value"]) for v in by_get["values"]] == [("serve.api.t03", "3.5")]
    assert by_get["values"][0]["time"].endswith("Z")
    assert by_get["missing"] == ["serve.api.none"]
    status, _, by_post = readonly.api(
        "/api/read", "POST", json.dumps({"paths": ["serve.api.t01", "serve.api.t02"]}),
        {"Content-Type": "application/json"})
    assert status == 200, by_post
    assert [v["value"] for v in by_post["values"]] == ["1.5", "2.5"]
    assert by_post["missing"] == []


def test_write_needs_allow_write_and_the_token(readonly, writable):
    body = json.dumps({"path": "serve.api.t00", "value": 77})
    status, _, refused = readonly.api("/api/write", "POST", body, {"X-Kvtag-Token": "x"})
    assert (status, refused["error"]) == (403, "writing is off; start kvtag serve with --allow-write")
    for headers in ({}, {"X-Kvtag-Token": "0" * 32}):
        status, _, refused = writable.api("/api/write", "POST", body, headers)
        assert status == 403 and "X-Kvtag-Token" in refused["error"]
    status, _, written = writable.api("/api/write", "POST", body, {"X-Kvtag-Token": writable.token})
    assert status == 200, written
    assert kvtag("read", "serve.api.t00").split("\t")[2] == "77"
    status, _, refused = writable.api(
        "/api/write", "POST", json.dumps({"path": "serve.api.t00", "value": "abc"}),
        {"X-Kvtag-Token": writable.token})
    assert status == 400 and "'abc' is not a value of type double" in refused["error"]


@pytest.mark.parametrize("method, path, body, status, fragment", [
    ("POST", "/api/read", '{"paths": [', 400, "not JSON: line 1, column 12"),
    ("POST", "/api/read", '["serve.api.t01"]', 400, "must be a JSON object"),
    ("POST", "/api/read", '{"paths": ["a"], "x": 1}', 400, 'unknown member "x"'),
    ("POST", "/api/read", '{"paths": ["a.*"]}', 400, "may not hold '*'"),
    ("POST", "/api/read", '{"paths": ["' + "a" * 70000 + '"]}', 413, "over 65536 bytes"),
    ("GET", "/api/list?skip=1", None, 400, "give a pattern"),
    ("GET", "/api/list?pattern=a&take=x", None, 400, "take needs a whole number"),
    ("GET", "/api/list?pattern=%zz", None, 400, "two hexadecimal digits"),
    ("GET", "/api/read", None, 400, "no path to read"),
    ("GET", "/api/nothing", None, 404, "nothing at /api/nothing"),
    ("DELETE", "/api/list?pattern=a", None, 405, "use GET"),
    ("GET", "/api/write", None, 405, "use POST"),
])
def test_bad_requests_get_a_status_and_a_message(readonly, method, path, body, status, fragment):
    got, headers, answer = readonly.api(path, method, body)
    assert got == status, answer
    assert fragment in answer["error"]
    if status == 405:
        assert headers["Allow"] in ("GET", "POST")


def test_on_loopback_only_requests_for_a_loopback_host_are_answered(readonly):
    port = urllib.parse.urlsplit(readonly.url).port
    for host in (f"localhost:{port}", f"[::1]:{port}", "127.0.0.1"):
        assert readonly.api("/api/list?pattern=a", "GET", None, {"Host": host})[0] == 200, host
    status, _, refused = readonly.api("/", "GET", None, {"Host": f"rebound.example:{port}"})
    assert status == 403 and "rebound.example" in refused["error"]


def test_the_page_carries_its_safety_headers_and_no_token_when_read_only(readonly, writable):
    status, headers, page = readonly.api("/")
    assert status == 200
    assert "script-src 'self'" in headers["Content-Security-Policy"]
    assert "unsafe" not in headers["Content-Security-Policy"]
    assert headers["X-Content-Type-Options"] == "nosniff"
    assert "kvtag-token" not in page and 'id="write"' not in page
    assert 'id="write"' in writable.api("/")[2]


def test_a_silent_client_holds_up_no_other(readonly):
    port = urllib.parse.urlsplit(readonly.url).port
    silent = [socket.create_connection(("127.0.0.1", port)) for _ in range(4)]
    try:
        silent[0].sendall(b"GET /api/list?pattern=serve.api.* HTTP/1.1\r\nHost: x\r\n")
        started = time.monotonic()
        assert listing(readonly, "serve.api.t0*", 0, 100)["total"] == 10
        assert time.monotonic() - started < 5
    finally:
        for connection in silent:
            connection.close()
