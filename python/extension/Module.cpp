// The module itself.
#include "State.h"

namespace {

PyObject* TakeErrorMaker(PyObject* /*module*/, PyObject* maker) noexcept {
    Python::SetErrorMaker(maker);
    return Python::Ref::None().Release();
}

PyObject* MakeCatalogue(PyObject* /*module*/, PyObject* /*none*/) noexcept {
    try {
        const Python::Ref list = Python::MakeList();
        for (const Orn_Hdl::CommandInfo& command : Orn_Hdl::CommandFactory::GetCatalogue()) {
            Python::Append(list, Python::MakeTuple(Python::MakeText(command.phrase),
                                                   Python::MakeText(command.arguments),
                                                   Python::MakeText(command.help)));
        }
        return Python::Ref::Share(list.Get()).Release();
    } catch (...) {
        Python::SetError();
        return nullptr;
    }
}

PyMethodDef functions[] = {
    {"set_error_maker", &TakeErrorMaker, METH_O, "Sets the function that makes exceptions."},
    {"catalogue", &MakeCatalogue, METH_NOARGS, "The phrases of the command language."},
    {nullptr, nullptr, 0, nullptr}};

PyModuleDef definition = {PyModuleDef_HEAD_INIT,
                          "_orn_hdl",
                          "The library as the package orn_hdl uses it.",
                          -1,
                          functions,
                          nullptr,
                          nullptr,
                          nullptr,
                          nullptr};

} // namespace

/// Called by Python when the module is imported.
PyMODINIT_FUNC PyInit__orn_hdl() { // NOLINT(readability-identifier-naming)
    try {
        Python::Ref module = Python::Ref::Take(PyModule_Create(&definition));
        Python::AddEngineType(module.Get());
        Python::AddModelType(module.Get());
        Python::AddWalkTypes();
        const Port::String version = Orn_Hdl::HdlUtilities::GetVersion();
        if (PyModule_AddStringConstant(module.Get(), "VERSION", version.CStr()) != 0) {
            return nullptr;
        }
        return module.Release();
    } catch (...) {
        Python::SetError();
        return nullptr;
    }
}
