"""The records that reads and listings return."""

from datetime import datetime
from typing import TYPE_CHECKING, Any, List, NamedTuple, Optional

if TYPE_CHECKING:
    from ._kvveldra import Tag


class Aggregates(NamedTuple):
    """A tag's aggregates since its last reset. With no samples counted (or a
    tag that collects none) ``count`` is 0 and the other three are None."""

    count: int
    average: Optional[float]
    minimum: Any
    maximum: Any


class Value(NamedTuple):
    """A tag's current value as a read gives it. ``value`` and ``timestamp``
    are None for a tag that was never written."""

    path: str
    data_type: int
    value: Any
    timestamp: Optional[datetime]
    aggregates: Aggregates


class Listing(NamedTuple):
    """A page of a listing: the open tags of the page, in the service's
    order, and the count of all matches."""

    tags: List["Tag"]
    total: int
