"""The calls of Client and Tag against the reference tag service, the errors
they raise, their closes, and threads sharing a client."""

import threading
from datetime import datetime, timedelta, timezone

import pytest

import kvveldra


def test_write_many_and_aggregates(client, prefix):
    tag = client.create(prefix, kvveldra.DOUBLE)
    assert tag.collect_aggregates is False
    tag.set_collect_aggregates(True)
    assert tag.collect_aggregates is True
    start = datetime.now(timezone.utc)
    tag.write_many([1.0, (3.0, start + timedelta(seconds=1)), (2, None)])
    read = tag.read()
    assert read.value == 2.0
    assert read.aggregates == kvveldra.Aggregates(3, 2.0, 1.0, 3.0)
    tag.reset_aggregates()
    assert tag.read().aggregates.count == 0

    text = client.create(prefix + ".text", kvveldra.STRING)
    with pytest.raises(kvveldra.Error) as refused:
        text.set_collect_aggregates(True)
    assert refused.value.code == -251908 and str(refused.value) == refused.value.text


def test_keywords_and_properties_are_replaced_and_read(client, prefix):
    tag = client.create(prefix, kvveldra.INT)
    tag.keywords = ["line1", "pump"]
    tag.properties = {"unit": "l/min", "owner": "lab 3"}
    assert sorted(tag.keywords) == ["line1", "pump"]
    assert tag.properties == {"unit": "l/min", "owner": "lab 3"}
    tag.keywords = []
    assert tag.keywords == []


def test_open_list_and_read_many(client, prefix):
    for i, value in enumerate([1, 2, 3]):
        client.create(f"{prefix}.t{i}", kvveldra.INT).write(value)

    opened = client.open(f"{prefix}.t1")
    assert (opened.path, opened.data_type, opened.read().value) == (f"{prefix}.t1", kvveldra.INT, 2)

    page = client.list(prefix + ".*", skip=1, take=1)
    assert page.total == 3 and [t.path for t in page.tags] == [f"{prefix}.t1"]
    every = client.list(prefix + ".*", take=0)
    values = client.read_many(every.tags)
    assert sorted((v.path, v.value) for v in values) == [
        (f"{prefix}.t0", 1), (f"{prefix}.t1", 2), (f"{prefix}.t2", 3)]
    assert client.list(prefix + ".nothing.*") == kvveldra.Listing([], 0)
    assert client.list(prefix + ".*", keywords=["absent"]).total == 0
    assert client.read_many([]) == []

    with pytest.raises(kvveldra.NoSuchTagError) as missing:
        client.open(prefix + ".absent")
    assert missing.value.code == -251909 and isinstance(missing.value, kvveldra.Error)
    with pytest.raises(kvveldra.Error, match="list takes patterns") as pattern:
        client.open(prefix + ".*")
    assert pattern.value.code == -251904
    with pytest.raises(kvveldra.Error) as conflict:
        client.create(f"{prefix}.t0", kvveldra.DOUBLE)
    assert conflict.value.code == -251907


def test_a_tag_deleted_under_an_open_handle(client, prefix):
    tag = client.create(prefix, kvveldra.DOUBLE)
    other = client.open(prefix)
    tag.write(1.5)
    tag.delete()
    with pytest.raises(kvveldra.NoSuchTagError):
        other.read()
    with pytest.raises(kvveldra.NoSuchTagError):
        other.keywords
    with pytest.raises(kvveldra.NoSuchTagError):
        client.open(prefix)
    other.close()
    tag.close()


def test_use_after_close_raises_closed_error(world, prefix):
    with pytest.raises(ZeroDivisionError):
        with kvveldra.Client() as client:
            tag = client.create(prefix, kvveldra.BOOL)
            alone = client.create(prefix + ".alone", kvveldra.BOOL)
            alone.close()
            with pytest.raises(kvveldra.ClosedError, match="tag '.*alone' is closed"):
                alone.write(True)
            with pytest.raises(ValueError, match="another open Client"):
                kvveldra.Client()
            1 / 0
    assert client.closed and tag.closed
    for call in (lambda: client.open(prefix), lambda: client.list("*"),
                 lambda: tag.write(True), lambda: tag.read(), lambda: tag.keywords):
        with pytest.raises(kvveldra.ClosedError, match="Client of instance 0 is closed") as raised:
            call()
        assert isinstance(raised.value, RuntimeError) and raised.value.code == -251900
    tag.close()
    client.close()
    # The instance is free again.
    with kvveldra.Client() as again:
        assert again.open(prefix).read().value is None


def test_statuses_map_to_the_exceptions():
    from kvveldra._errors import error_for
    assert type(error_for(-251909, "x")) is kvveldra.NoSuchTagError
    timeout = error_for(-251001, "Request timed out.")
    assert isinstance(timeout, kvveldra.TimeoutError) and isinstance(timeout, TimeoutError)
    assert str(timeout) == "Request timed out." and timeout.code == -251001
    for code in (-251017, -251022, -251036, -251040):
        assert type(error_for(code, "x")) is kvveldra.NotConnectedError
    for code in (-251016, -251037, -251900, 1):
        assert type(error_for(code, "x")) is kvveldra.Error


def test_a_broker_out_of_reach_fails_while_other_threads_run(world):
    stop = threading.Event()
    turns = []

    def count():
        while not stop.is_set():
            turns.append(1)

    counter = threading.Thread(target=count)
    counter.start()
    try:
        with pytest.raises(kvveldra.NotConnectedError) as refused:
            kvveldra.Client(5, configuration="unreachable", allow_fallback=False, timeout_ms=500)
    finally:
        stop.set()
        counter.join()
    assert refused.value.code < 0
    # The initialize waited without the GIL.
    assert len(turns) > 1000


def test_threads_share_one_client(client, prefix):
    shared = client.create(prefix, kvveldra.INT)
    shared.set_collect_aggregates(True)
    writes = 25
    failures = []

    def writer(number):
        try:
            own = client.create(f"{prefix}.w{number}", kvveldra.INT)
            for i in range(writes):
                shared.write(i)
                own.write(number * 100 + i)
        except Exception as error:  # reported below
            failures.append(error)

    threads = [threading.Thread(target=writer, args=(n,)) for n in range(4)]
    for thread in threads:
        thread.start()
    for thread in threads:
        thread.join()
    assert failures == []
    assert shared.read().aggregates.count == 4 * writes
    own = client.list(prefix + ".w*", take=0).tags
    assert sorted(v.value for v in client.read_many(own)) == [24, 124, 224, 324]
