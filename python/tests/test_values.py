"""Values of each data type through write and read, and the values refused."""

from datetime import datetime, timedelta, timezone

import pytest

import kvveldra

WHEN = datetime(2026, 3, 1, 9, 30, 0, 250000, tzinfo=timezone(timedelta(hours=1)))


@pytest.mark.parametrize("data_type, value", [
    (kvveldra.DOUBLE, 12.5),
    (kvveldra.DOUBLE, float("inf")),
    (kvveldra.INT, -2**31),
    (kvveldra.INT, 2**31 - 1),
    (kvveldra.STRING, 'Ana "night shift" \u00e9'),
    (kvveldra.STRING, ""),
    (kvveldra.BOOL, True),
    (kvveldra.BOOL, False),
    (kvveldra.UINT64, 2**64 - 1),
    (kvveldra.DATETIME, WHEN),
])
def test_each_type_reads_back_what_was_written(client, prefix, data_type, value):
    tag = client.create(prefix, data_type)
    assert (tag.path, tag.data_type) == (prefix, data_type)
    tag.write(value, timestamp=WHEN)
    read = tag.read()
    assert (read.path, read.data_type, read.value) == (prefix, data_type, value)
    assert type(read.value) is type(value)
    # Times come back in UTC.
    assert read.timestamp == WHEN and read.timestamp.utcoffset() == timedelta(0)
    assert read.aggregates == kvveldra.Aggregates(0, None, None, None)


def test_a_tag_never_written_reads_as_none_and_a_write_without_time_is_now(client, prefix):
    tag = client.create(prefix, kvveldra.INT)
    assert (tag.read().value, tag.read().timestamp) == (None, None)
    before = datetime.now(timezone.utc)
    tag.write(7)
    assert before - timedelta(seconds=1) <= tag.read().timestamp <= datetime.now(timezone.utc)


@pytest.mark.parametrize("data_type, value, error, words", [
    (kvveldra.INT, True, TypeError, "is INT and takes an int, not bool"),
    (kvveldra.UINT64, False, TypeError, "not bool"),
    (kvveldra.DOUBLE, True, TypeError, "not bool"),
    (kvveldra.BOOL, 1, TypeError, "is BOOL and takes a bool, not int"),
    (kvveldra.DOUBLE, "12.5", TypeError, "not str"),
    (kvveldra.STRING, 3, TypeError, "not int"),
    (kvveldra.DATETIME, "2026-03-01T08:30:00Z", TypeError, "timezone-aware datetime, not str"),
    (kvveldra.INT, 2**31, ValueError, "outside -2147483648 to 2147483647"),
    (kvveldra.UINT64, -1, ValueError, "outside 0 to 18446744073709551615"),
    (kvveldra.UINT64, 2**64, ValueError, "outside"),
    (kvveldra.DOUBLE, 10**400, ValueError, "beyond the range of a float"),
    (kvveldra.DATETIME, datetime(2026, 3, 1), ValueError, "naive datetime"),
])
def test_a_value_that_does_not_fit_is_refused_before_it_is_sent(
        client, prefix, data_type, value, error, words):
    tag = client.create(prefix, data_type)
    with pytest.raises(error, match=words) as raised:
        tag.write(value)
    assert f"'{prefix}'" in str(raised.value)
    assert tag.read().value is None


def test_bad_arguments_are_refused(client, prefix):
    tag = client.create(prefix, kvveldra.DOUBLE)
    with pytest.raises(ValueError, match="naive datetime"):
        tag.write(1.0, timestamp=datetime(2026, 3, 1))
    with pytest.raises(TypeError, match="timezone-aware datetime"):
        tag.write(1.0, timestamp=1700000000)
    with pytest.raises(ValueError, match="no values"):
        tag.write_many([])
    with pytest.raises(TypeError, match="list of values"):
        tag.write_many("12")
    with pytest.raises(ValueError, match="pair"):
        tag.write_many([(1.0, None, None)])
    with pytest.raises(TypeError, match="must hold str, not int"):
        tag.keywords = ["a", 1]
    with pytest.raises(TypeError, match="list of str, not str"):
        tag.keywords = "abc"
    with pytest.raises(TypeError, match="must hold str"):
        tag.properties = {"unit": 5}
    with pytest.raises(ValueError, match="none of DOUBLE"):
        client.create(prefix + ".x", 6)
    assert tag.read().value is None
