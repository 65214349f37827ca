// The type of engines.
#include "State.h"

namespace Python {

namespace {

EngineState& StateOf(PyObject* self) {
    return *reinterpret_cast<EngineObject*>(self)->state;
}

Orn_Hdl::Engine& EngineOf(EngineState& state) {
    if (state.engine == nullptr) {
        throw Failure{"closed", "The engine has been closed.\n"};
    }
    return *state.engine;
}

PyObject* NewEngine(PyTypeObject* type, PyObject* /*arguments*/, PyObject* /*keywords*/) noexcept {
    try {
        Ref object = Ref::Take(Allocate(type));
        reinterpret_cast<EngineObject*>(object.Get())->state = new EngineState;
        return object.Release();
    } catch (...) {
        SetError();
        return nullptr;
    }
}

void DeallocateEngine(PyObject* self) noexcept {
    delete reinterpret_cast<EngineObject*>(self)->state;
    Free(self);
}

Ref CreateModel(PyObject* self, Arguments& arguments) {
    EngineState& state = StateOf(self);
    Orn_Hdl::Engine& engine = EngineOf(state);
    const char* const name = arguments.GetText(0);
    if (!engine.CreateAndAddModel(name, arguments.GetText(1))) {
        throw Failure{"taken", "Identifier \"" + std::string(name) + "\" already defined.\n"};
    }
    Ref object = Ref::Take(Allocate(modelType));
    auto* const model = new ModelState{object.Get(), Ref::Share(self), engine.GetModel(name)};
    reinterpret_cast<ModelObject*>(object.Get())->state = model;
    state.models.push_back(model);
    return object;
}

/// Removes the model itself; its name may have changed since.
Ref RemoveModel(PyObject* self, Arguments& arguments) {
    EngineState& state = StateOf(self);
    Orn_Hdl::Engine& engine = EngineOf(state);
    if (PyObject_IsInstance(arguments.Get(0), reinterpret_cast<PyObject*>(modelType)) != 1) {
        PyErr_SetString(PyExc_TypeError, "a model is expected");
        throw ErrorIsSet();
    }
    ModelState& model = *reinterpret_cast<ModelObject*>(arguments.Get(0))->state;
    if (model.model == nullptr || model.engine.Get() != self) {
        return Ref::None();
    }
    const Port::StringBase<char> name = model.Get().GetName();
    if (engine.GetModel(name) != model.model) {
        throw Failure{"library", "Two models of the engine have the name \"" +
                                     std::string(name.GetView()) + "\".\n"};
    }
    model.ForgetObjects();
    model.model = nullptr;
    engine.RemoveModel(name);
    return Ref::None();
}

Ref Close(PyObject* self, Arguments& /*arguments*/) {
    EngineState& state = StateOf(self);
    for (ModelState* const model : state.models) {
        model->ForgetObjects();
        model->model = nullptr;
    }
    const std::unique_ptr<Orn_Hdl::Engine> engine = std::move(state.engine);
    return Ref::None();
}

Ref IsClosed(PyObject* self, Arguments& /*arguments*/) {
    return MakeBool(reinterpret_cast<EngineObject*>(self)->state->engine == nullptr);
}

template <Ref (*Function)(PyObject*, Arguments&), int Count>
PyObject* CallEngine(PyObject* self, PyObject* tuple) noexcept {
    try {
        Arguments arguments(tuple, Count);
        const Use use(StateOf(self));
        return Function(self, arguments).Release();
    } catch (...) {
        SetError();
        return nullptr;
    }
}

} // namespace

void AddEngineType(PyObject* module) {
    static PyMethodDef methods[] = {
        {"create", &CallEngine<CreateModel, 2>, METH_VARARGS, "Makes a model."},
        {"remove", &CallEngine<RemoveModel, 1>, METH_VARARGS, "Removes a model."},
        {"close", &CallEngine<Close, 0>, METH_VARARGS, "Removes all models."},
        {"is_closed", &CallEngine<IsClosed, 0>, METH_VARARGS, "Whether it has been closed."},
        {nullptr, nullptr, 0, nullptr}};
    static PyType_Slot slots[] = {{Py_tp_new, reinterpret_cast<void*>(&NewEngine)},
                                  {Py_tp_dealloc, reinterpret_cast<void*>(&DeallocateEngine)},
                                  {Py_tp_methods, methods},
                                  {0, nullptr}};
    static PyType_Spec spec = {"orn_hdl._orn_hdl.Engine", sizeof(EngineObject), 0,
                               Py_TPFLAGS_DEFAULT, slots};
    if (PyModule_AddObject(module, "Engine", reinterpret_cast<PyObject*>(MakeType(spec))) != 0) {
        throw ErrorIsSet();
    }
}

} // namespace Python
