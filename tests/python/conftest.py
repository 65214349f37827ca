"""A sanitizer's library that is loaded for this interpreter is not meant for the programs that tests start."""

import os

os.environ.pop("LD_PRELOAD", None)
