// The part of CPython's interface that does not change from 3.9 on, so that one build of the
// extension serves every later version.
#pragma once

#define PY_SSIZE_T_CLEAN
#define Py_LIMITED_API 0x03090000 // NOLINT(readability-identifier-naming)
#include <Python.h>
