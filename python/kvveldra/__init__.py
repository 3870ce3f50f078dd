"""Tags of a tag service over a RabbitMQ broker, from Python.

A thin, blocking layer over the library's ``TagConsole*`` functions::

    import kvveldra
    from datetime import datetime, timezone

    with kvveldra.Client() as client:            # reserves and initializes instance 0
        flow = client.create("line1.flow", kvveldra.DOUBLE)
        flow.write(12.5)
        flow.write_many([13.25, (11.75, datetime.now(timezone.utc))])
        print(flow.read())                       # Value(path=..., value=11.75, ...)
        page = client.list("line1.*", take=10)   # Listing(tags=[...], total=...)

Values are ``float`` (DOUBLE), ``int`` (INT: 32 bits; UINT64: 0 to 2**64-1),
``str`` (STRING), ``bool`` (BOOL) and timezone-aware ``datetime`` (DATETIME).
A value of another type raises ``TypeError``; one out of range, or a naive
``datetime``, ``ValueError``. A refusal of the library or the service raises
``Error`` or one of its subclasses, with the library's ``code`` and ``text``.

Every call that waits for the broker releases the GIL, and threads may share
one client. The data root (``VELDRA_DATA_DIR``) and its broker configurations
are those of the C++ library: see the user's guide.
"""

from ._errors import ClosedError, Error, NoSuchTagError, NotConnectedError, TimeoutError
from ._records import Aggregates, Listing, Value
from ._kvveldra import BOOL, DATETIME, DOUBLE, INT, STRING, UINT64, Client, Tag

__all__ = [
    "Aggregates", "BOOL", "Client", "ClosedError", "DATETIME", "DOUBLE", "Error", "INT",
    "Listing", "NoSuchTagError", "NotConnectedError", "STRING", "Tag", "TimeoutError",
    "UINT64", "Value",
]

# Shown as kvveldra's own in help() and in tracebacks.
for _name in __all__:
    _item = globals()[_name]
    if isinstance(_item, type):
        _item.__module__ = __name__
del _name, _item
