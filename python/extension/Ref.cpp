#include "Ref.h"

#include <cstring>

namespace Python {

namespace {

constexpr const char* OtherBytes = "surrogateescape";

} // namespace

Text::Text(PyObject* text) {
    if (PyUnicode_Check(text) == 0) {
        PyErr_SetString(PyExc_TypeError, "a str is expected");
        throw ErrorIsSet();
    }
    PyObject* bytes = PyUnicode_AsUTF8String(text);
    if (bytes == nullptr) {
        PyErr_Clear();
        bytes = PyUnicode_AsEncodedString(text, "utf-8", OtherBytes);
    }
    bytes_ = Ref::Take(bytes);
    text_ = PyBytes_AsString(bytes);
    if (std::strlen(text_) != static_cast<std::size_t>(PyBytes_Size(bytes))) {
        PyErr_SetString(PyExc_ValueError, "a text must not contain a NUL");
        throw ErrorIsSet();
    }
}

Ref MakeText(std::string_view text) {
    const auto size = static_cast<Py_ssize_t>(text.size());
    // A temporary lives until the call that it is made for returns.
    // cppcheck-suppress danglingTemporaryLifetime
    PyObject* object = PyUnicode_FromStringAndSize(text.data(), size);
    if (object == nullptr) {
        PyErr_Clear();
        object = PyUnicode_DecodeUTF8(text.data(), size, OtherBytes);
    }
    return Ref::Take(object);
}

Ref MakeInt(long long value) {
    return Ref::Take(PyLong_FromLongLong(value));
}

Ref MakeBool(bool value) noexcept {
    return Ref::Share(value ? Py_True : Py_False);
}

Ref MakeList() {
    return Ref::Take(PyList_New(0));
}

void Append(const Ref& list, const Ref& item) {
    if (PyList_Append(list.Get(), item.Get()) != 0) {
        throw ErrorIsSet();
    }
}

} // namespace Python
