// References to objects of Python, and texts in both directions.
#pragma once

#include "Api.h"

#include <string_view>
#include <utility>

namespace Python {

/// Thrown when an exception of Python is set.
struct ErrorIsSet {};

/// An owned reference, or none.
class Ref {
public:
    Ref() noexcept = default;
    /// Takes over a new reference, which a function of Python has returned. \throws ErrorIsSet for
    /// null, which means that the function has failed.
    static Ref Take(PyObject* object) {
        if (object == nullptr) {
            throw ErrorIsSet();
        }
        return Ref(object);
    }
    /// Makes a reference to an object that somebody else refers to; null gives none.
    static Ref Share(PyObject* object) noexcept {
        Py_XINCREF(object);
        return Ref(object);
    }
    /// A reference to None.
    static Ref None() noexcept { return Share(Py_None); }

    Ref(const Ref&) = delete;
    Ref& operator=(const Ref&) = delete;
    Ref(Ref&& other) noexcept : object_(std::exchange(other.object_, nullptr)) {}
    Ref& operator=(Ref&& other) noexcept {
        // The former object may run any code when it goes, so it goes last.
        const Ref former(std::exchange(object_, std::exchange(other.object_, nullptr)));
        return *this;
    }
    ~Ref() { Py_XDECREF(object_); }

    /// The object, which stays owned; null for none.
    PyObject* Get() const noexcept { return object_; }
    /// Hands the reference over to the caller.
    PyObject* Release() noexcept { return std::exchange(object_, nullptr); }
    /// Whether there is an object.
    explicit operator bool() const noexcept { return object_ != nullptr; }

private:
    explicit Ref(PyObject* object) noexcept : object_(object) {}

    PyObject* object_ = nullptr;
};

/// A str as the library takes texts: UTF-8 that ends in NUL. What is no UTF-8 in a design's names
/// is kept in the way of Python's file names, by "surrogateescape".
class Text {
public:
    Text() noexcept = default;
    /// \throws ErrorIsSet: a TypeError for what is no str, a ValueError for one with a NUL.
    explicit Text(PyObject* text);

    /// The text, valid as long as this object.
    const char* Get() const noexcept { return text_; }
    /// The text, valid as long as this object.
    std::string_view GetView() const noexcept { return text_; }

private:
    Ref bytes_;
    const char* text_ = "";
};

/// A str of a text of the library.
Ref MakeText(std::string_view text);
/// An int.
Ref MakeInt(long long value);
/// A bool.
Ref MakeBool(bool value) noexcept;
/// An empty list.
Ref MakeList();
/// Appends to a list.
void Append(const Ref& list, const Ref& item);

/// A tuple of the items, in order.
template <class... Items> Ref MakeTuple(Items... items) {
    Ref tuple = Ref::Take(PyTuple_New(static_cast<Py_ssize_t>(sizeof...(items))));
    Py_ssize_t place = 0;
    // A tuple takes the reference over, also when it fails.
    (PyTuple_SetItem(tuple.Get(), place++, items.Release()), ...);
    return tuple;
}

} // namespace Python
