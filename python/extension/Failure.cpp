#include "Failure.h"

#include "Orn_Hdl/Orn_Hdl.h"

#include <exception>
#include <new>

namespace Python {

namespace {

PyObject* errorMaker = nullptr;

std::string TextOf(const Orn_Hdl::Exception& exception) {
    return std::string(exception.getLocalized().GetView());
}

Ref MakeOptionalText(const std::string& text) {
    return text.empty() ? Ref::None() : MakeText(text);
}

void Raise(const Failure& failure, Ref details) {
    if (errorMaker == nullptr) {
        PyErr_SetString(PyExc_RuntimeError, failure.text.c_str());
        return;
    }
    const Ref arguments =
        MakeTuple(MakeText(failure.kind), MakeText(failure.text), MakeOptionalText(failure.file),
                  MakeInt(static_cast<long long>(failure.line)), MakeOptionalText(failure.command),
                  std::move(details));
    const Ref error = Ref::Take(PyObject_CallObject(errorMaker, arguments.Get()));
    PyErr_SetObject(reinterpret_cast<PyObject*>(Py_TYPE(error.Get())), error.Get());
}

void SetErrorFor(const std::exception_ptr& thrown) {
    try {
        std::rethrow_exception(thrown);
    } catch (const ErrorIsSet&) {
        return;
    } catch (const Failure& failure) {
        Raise(failure, Ref::None());
    } catch (const Orn_Hdl::ProofException& exception) {
        Raise({"proof", TextOf(exception)}, MakeDifferences(exception.GetDifferences()));
    } catch (const Orn_Hdl::Exception& exception) {
        Raise({"library", TextOf(exception)}, Ref::None());
    } catch (const std::bad_alloc&) {
        PyErr_NoMemory();
    } catch (const std::exception& exception) {
        PyErr_SetString(PyExc_RuntimeError, exception.what());
    }
}

} // namespace

Ref MakeDifferences(const std::vector<Orn_Hdl::Proof::Difference>& differences) {
    Ref list = MakeList();
    for (const Orn_Hdl::Proof::Difference& difference : differences) {
        Append(list, MakeTuple(MakeText(difference.message),
                               MakeInt(static_cast<long long>(difference.line)),
                               MakeInt(static_cast<long long>(difference.column)),
                               MakeText(difference.source)));
    }
    return list;
}

void SetErrorMaker(PyObject* maker) noexcept {
    Py_XINCREF(maker);
    Py_XDECREF(std::exchange(errorMaker, maker));
}

void SetError() noexcept {
    try {
        SetErrorFor(std::current_exception());
    } catch (const ErrorIsSet&) { // NOLINT(bugprone-empty-catch)
        // Making the exception has failed, and that is raised instead.
    } catch (const std::bad_alloc&) {
        PyErr_NoMemory();
    }
}

void RethrowForCommand(std::string command, std::string file, std::uint64_t line) {
    try {
        throw;
    } catch (const Orn_Hdl::ProofException&) {
        throw;
    } catch (const Orn_Hdl::Exception& exception) {
        throw Failure{"library", TextOf(exception), std::move(file), line, std::move(command)};
    }
}

} // namespace Python
