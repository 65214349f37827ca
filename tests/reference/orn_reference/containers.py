"""The two name containers: a set whose walk order is part of the output, and a name map."""

from __future__ import annotations

from typing import Generic, Iterator, Optional, TypeVar

T = TypeVar("T")

BUCKET_COUNTS = (
    53, 97, 193, 389, 769, 1543, 3079, 6151, 12289, 24593, 49157, 98317, 196613, 393241, 786433,
    1572869, 3145739, 6291469, 12582917, 25165843, 50331653, 100663319, 201326611, 402653189,
    805306457, 1610612741, 3221225473, 4294967291,
)
REQUESTED_SIZE = 100


def hash_name(name: bytes) -> int:
    """djb2 over the bytes read as signed 8-bit values, in 32 bits."""
    value = 5381
    for byte in name:
        value = (value * 33 + (byte - 256 if byte >= 128 else byte)) % 2**32
    return value


def bucket_count_for(count: int) -> int:
    return next(prime for prime in BUCKET_COUNTS if prime >= count)


class HashTable:
    """A chained table of names, one list a bucket; walking visits bucket after bucket."""

    def __init__(self) -> None:
        self._bucket_count = bucket_count_for(REQUESTED_SIZE)
        self._buckets: dict[int, list[bytes]] = {}
        self._names: set[bytes] = set()

    def __contains__(self, name: bytes) -> bool:
        return name in self._names

    def __len__(self) -> int:
        return len(self._names)

    def __iter__(self) -> Iterator[bytes]:
        for number in sorted(self._buckets):
            yield from self._buckets[number]

    def add(self, name: bytes) -> None:
        if name in self._names:
            return
        if len(self._names) + 1 > self._bucket_count:
            self._grow(bucket_count_for(len(self._names) + 1))
        bucket = self._buckets.setdefault(hash_name(name) % self._bucket_count, [])
        bucket.insert(1, name)  # behind the first element, or alone
        self._names.add(name)

    def remove(self, name: bytes) -> None:
        if name not in self._names:
            return
        self._names.remove(name)
        number = hash_name(name) % self._bucket_count
        self._buckets[number].remove(name)
        if not self._buckets[number]:
            del self._buckets[number]

    def clear(self) -> None:
        """Drops the names; the bucket count stays."""
        self._buckets.clear()
        self._names.clear()

    def _grow(self, bucket_count: int) -> None:
        """Moves every element, in walk order, to the front of its bucket."""
        names = list(self)
        self._bucket_count = bucket_count
        self._buckets = {}
        for name in names:
            self._buckets.setdefault(hash_name(name) % bucket_count, []).insert(0, name)


class StringSet:
    """Names with exact and case-ignoring membership; `empty` forgets only the exact ones."""

    def __init__(self) -> None:
        self._exact = HashTable()
        self._spelling: dict[bytes, bytes] = {}

    def add(self, name: bytes) -> None:
        self._spelling.setdefault(name.upper(), name)
        self._exact.add(name)

    def remove(self, name: bytes) -> None:
        self._spelling.pop(name.upper(), None)
        self._exact.remove(name)

    def contains(self, name: bytes) -> bool:
        return name in self._exact

    def contains_ignoring_case(self, name: bytes) -> bool:
        return name.upper() in self._spelling

    def is_empty(self) -> bool:
        return len(self._exact) == 0

    def empty(self) -> None:
        self._exact.clear()

    def __iter__(self) -> Iterator[bytes]:
        return iter(self._exact)


class NameMap(Generic[T]):
    """A case-ignoring map from a name to an object that it does not own."""

    def __init__(self) -> None:
        self._entries: dict[bytes, T] = {}

    def add(self, name: bytes, value: T) -> None:
        self._entries[name.upper()] = value

    def get(self, name: bytes) -> Optional[T]:
        return self._entries.get(name.upper())

    def remove_if_holds(self, name: bytes, value: T) -> None:
        if self._entries.get(name.upper()) is value:
            del self._entries[name.upper()]
