// The type of models, put together from the tables of functions.
#include "State.h"

#include <algorithm>

namespace Python {

PyTypeObject* modelType = nullptr;

namespace {

PyObject* NewModel(PyTypeObject* /*type*/, PyObject* /*arguments*/,
                   PyObject* /*keywords*/) noexcept {
    PyErr_SetString(PyExc_TypeError, "an engine makes its models");
    return nullptr;
}

void DeallocateModel(PyObject* self) noexcept {
    // An object whose making has failed has no state.
    if (ModelState* const state = reinterpret_cast<ModelObject*>(self)->state) {
        std::vector<ModelState*>& models = state->GetEngine().models;
        models.erase(std::remove(models.begin(), models.end(), state), models.end());
        delete state;
    }
    Free(self);
}

std::vector<PyMethodDef>& JoinTables() {
    static std::vector<PyMethodDef> rows;
    for (const auto* table : {&BuildingMethods, &ReadingMethods, &AttributeMethods, &OptionMethods,
                              &FileMethods, &BulkMethods}) {
        rows.insert(rows.end(), table->begin(), table->end());
    }
    rows.push_back({nullptr, nullptr, 0, nullptr});
    return rows;
}

} // namespace

void AddModelType(PyObject* module) {
    static PyType_Slot slots[] = {{Py_tp_new, reinterpret_cast<void*>(&NewModel)},
                                  {Py_tp_dealloc, reinterpret_cast<void*>(&DeallocateModel)},
                                  {Py_tp_methods, JoinTables().data()},
                                  {0, nullptr}};
    static PyType_Spec spec = {"orn_hdl._orn_hdl.Model", sizeof(ModelObject), 0, Py_TPFLAGS_DEFAULT,
                               slots};
    modelType = MakeType(spec);
    Py_INCREF(modelType);
    if (PyModule_AddObject(module, "Model", reinterpret_cast<PyObject*>(modelType)) != 0) {
        throw ErrorIsSet();
    }
}

} // namespace Python
