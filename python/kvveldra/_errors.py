"""The exceptions of kvveldra and the mapping of the library's statuses to them."""

import builtins


class Error(Exception):
    """A call the library or the tag service refused.

    ``code`` is the library's status (a negative error code, or 1 for a call
    that had nothing to act on) and ``text`` its text, which is also the
    message.
    """

    def __init__(self, code: int, text: str) -> None:
        super().__init__(text)
        self.code = code
        self.text = text

    def __reduce__(self):
        return (type(self), (self.code, self.text))


class NoSuchTagError(Error):
    """The tag does not exist (any more) on the service (-251909)."""


class TimeoutError(Error, builtins.TimeoutError):
    """No answer came within the request time-out of 10 s (-251001)."""


class NotConnectedError(Error):
    """The broker could not be reached, or the connection to it failed
    (the AMQP errors -251017 to -251036 and -251040)."""


class ClosedError(Error, RuntimeError):
    """A client or tag used after its close. Its code is -251900, the
    library's code for a reference that is no longer valid."""


NO_SUCH_TAG = -251909
REQUEST_TIMED_OUT = -251001
INVALID_TAG_REFERENCE = -251900
_CONNECTION_CODES = frozenset(list(range(-251036, -251016)) + [-251040])


def error_for(code: int, text: str) -> Error:
    """The exception for a failing status and its text."""
    if code == NO_SUCH_TAG:
        return NoSuchTagError(code, text)
    if code == REQUEST_TIMED_OUT:
        return TimeoutError(code, text)
    if code in _CONNECTION_CODES:
        return NotConnectedError(code, text)
    return Error(code, text)


def closed(text: str) -> ClosedError:
    """The exception for a use after close."""
    return ClosedError(INVALID_TAG_REFERENCE, text)
