#!/usr/bin/env python3
"""Replays a command file with the reference model: the same files, messages and exit status."""

from __future__ import annotations

import argparse
import os
import sys

from orn_reference.replay import replay


def main() -> int:
    parser = argparse.ArgumentParser(description=__doc__)
    parser.add_argument("file", metavar="FILE", type=os.fsencode)
    parser.add_argument("--model", metavar="NAME", type=os.fsencode)
    parser.add_argument("--verilog", metavar="OUT", type=os.fsencode)
    parser.add_argument("--vhdl", metavar="OUT", type=os.fsencode)
    parser.add_argument("--no-header", action="store_true")
    parser.add_argument("--keep-going", action="store_true")
    arguments = parser.parse_args()
    outcome = replay(
        arguments.file,
        model_name=arguments.model,
        verilog=arguments.verilog,
        vhdl=arguments.vhdl,
        header=not arguments.no_header,
        keep_going=arguments.keep_going,
    )
    for message in outcome.messages:
        sys.stderr.buffer.write(message + b"\n")
    return outcome.status


if __name__ == "__main__":
    sys.exit(main())
