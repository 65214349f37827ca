"""Splitting text into words."""

from __future__ import annotations

COMMAND_QUOTES = b"\"\"''"
_BACKSLASH = ord("\\")


def split(text: bytes, separators: bytes) -> list[bytes]:
    """The non-empty pieces between separator characters."""
    for separator in separators[1:]:
        text = text.replace(bytes([separator]), separators[:1])
    return [piece for piece in text.split(separators[:1]) if piece]


def split_quoted(text: bytes, separators: bytes, quotes: bytes) -> list[bytes]:
    """The pieces between separators; `quotes` lists opening and closing characters in pairs."""
    closers = {quotes[i]: quotes[i + 1] for i in range(0, len(quotes) - 1, 2)}
    pieces: list[bytes] = []
    piece = bytearray()
    closer = None  # the character that ends the present quoted part
    just_closed = False
    position = 0
    if text and text[0] in closers:
        closer = closers[text[0]]
        position = 1
    while position < len(text):
        character = text[position]
        following = text[position + 1] if position + 1 < len(text) else None
        position += 1
        if closer is not None:
            if character == _BACKSLASH and following == closer:
                piece.append(closer)
                position += 1
            elif character == closer:
                if following is None or following in separators:
                    closer = None
                    just_closed = True
            else:
                piece.append(character)
        elif character in separators:
            if piece or just_closed:
                pieces.append(bytes(piece))
            piece.clear()
            just_closed = False
            if following is not None and following in closers:
                closer = closers[following]
                position += 1
        else:
            piece.append(character)
    if piece:
        pieces.append(bytes(piece))
    return pieces


def split_command(line: bytes) -> list[bytes]:
    """The words of one command line: only spaces separate, both kinds of quote group."""
    if not any(quote in line for quote in (b'"', b"'")):
        return split(line, b" ")
    return split_quoted(line, b" ", COMMAND_QUOTES)
