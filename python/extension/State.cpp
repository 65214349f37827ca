#include "State.h"

namespace Python {

Orn_Hdl::Model& ModelState::Get() const {
    if (model == nullptr) {
        throw Failure{"closed", "The design has been closed.\n"};
    }
    return *model;
}

Use::Use(EngineState& engine) : engine_(engine) {
    if (engine.busy) {
        throw Failure{"busy", "The engine is in use by another call.\n"};
    }
    engine.busy = true;
}

Arguments::Arguments(PyObject* tuple, Py_ssize_t count) : tuple_(tuple) {
    if (PyTuple_Size(tuple) != count) {
        PyErr_Format(PyExc_TypeError, "%zd arguments are expected", count);
        throw ErrorIsSet();
    }
}

const char* Arguments::GetText(Py_ssize_t i) {
    Text& text = texts_.at(static_cast<std::size_t>(i));
    text = Text(Get(i));
    return text.Get();
}

long Arguments::GetInt(Py_ssize_t i) const {
    const long value = PyLong_AsLong(Get(i));
    if (value == -1 && PyErr_Occurred() != nullptr) {
        throw ErrorIsSet();
    }
    return value;
}

bool Arguments::GetBool(Py_ssize_t i) const {
    const int truth = PyObject_IsTrue(Get(i));
    if (truth < 0) {
        throw ErrorIsSet();
    }
    return truth != 0;
}

std::vector<std::string> TakeTexts(PyObject* list) {
    std::vector<std::string> texts;
    const Py_ssize_t size = PyList_Size(list);
    if (size < 0) {
        throw ErrorIsSet();
    }
    for (Py_ssize_t i = 0; i < size; ++i) {
        texts.emplace_back(Text(PyList_GetItem(list, i)).GetView());
    }
    return texts;
}

PyTypeObject* MakeType(PyType_Spec& spec) {
    return reinterpret_cast<PyTypeObject*>(Ref::Take(PyType_FromSpec(&spec)).Release());
}

PyObject* Allocate(PyTypeObject* type) {
    const auto allocate = reinterpret_cast<allocfunc>(PyType_GetSlot(type, Py_tp_alloc));
    return Ref::Take(allocate(type, 0)).Release();
}

void Free(PyObject* object) noexcept {
    PyTypeObject* const type = Py_TYPE(object);
    reinterpret_cast<freefunc>(PyType_GetSlot(type, Py_tp_free))(object);
    Py_DECREF(type);
}

} // namespace Python
