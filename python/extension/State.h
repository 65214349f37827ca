// The two types of the extension: an engine, and a model of an engine. Every function of a model
// looks its objects up by name, so nothing of Python points at an object of a design.
#pragma once

#include "Failure.h"
#include "Ref.h"

#include "Orn_Hdl/Orn_Hdl.h"

#include <array>
#include <cstdint>
#include <memory>
#include <unordered_map>
#include <vector>

namespace Python {

struct ModelState;

/// An engine and the models of it that Python knows.
struct EngineState {
    /// Null when it has been closed.
    std::unique_ptr<Orn_Hdl::Engine> engine = std::make_unique<Orn_Hdl::Engine>();
    /// Not owned.
    std::vector<ModelState*> models;
    /// Whether a call works on it, which may have let other threads run.
    bool busy = false;
};

/// The type of an engine.
struct EngineObject {
    PyObject_HEAD
        /// Owned.
        EngineState* state;
};

/// The instances that own pins: a pin does not know its owner.
using PinOwners = std::unordered_map<const Orn_Hdl::Pin*, const Orn_Hdl::Instance*>;

/// A model.
struct ModelState {
    /// The object of Python that owns this; not owned.
    PyObject* self = nullptr;
    /// Keeps the engine alive.
    Ref engine;
    /// Owned by the engine; null when it has been removed.
    Orn_Hdl::Model* model = nullptr;
    /// Counts how often the netlist has been replaced, so that walks notice it.
    std::uint64_t netlists = 0;
    /// Made when first asked for. It holds no pin that is destroyed, but may lack some.
    PinOwners pinOwners = {};

    EngineState& GetEngine() const noexcept {
        return *reinterpret_cast<EngineObject*>(engine.Get())->state;
    }
    /// The model. \throws Failure when it has been removed.
    Orn_Hdl::Model& Get() const;
    /// The netlist. \throws Failure when the model has been removed.
    Orn_Hdl::Netlist& GetNetlist() const { return *Get().GetNetlist(); }
    /// The netlist's objects are about to be destroyed.
    void ForgetObjects() noexcept {
        pinOwners.clear();
        ++netlists;
    }
};

/// The type of a model.
struct ModelObject {
    PyObject_HEAD
        /// Owned.
        ModelState* state;
};

/// The type of models; null before the module is imported.
extern PyTypeObject* modelType;

/// A call's use of an engine. While it lives no other call can use the engine: neither one from
/// another thread, when this one lets others run, nor one from a finalizer that the interpreter
/// runs meanwhile.
class Use {
public:
    /// \throws Failure "busy" when there is another use.
    explicit Use(EngineState& engine);
    Use(const Use&) = delete;
    Use& operator=(const Use&) = delete;
    ~Use() { engine_.busy = false; }

private:
    EngineState& engine_;
};

/// While it lives, other threads of Python run. There must be a `Use` of the engine.
class Unlocked {
public:
    Unlocked() noexcept : thread_(PyEval_SaveThread()) {}
    Unlocked(const Unlocked&) = delete;
    Unlocked& operator=(const Unlocked&) = delete;
    ~Unlocked() { PyEval_RestoreThread(thread_); }

private:
    PyThreadState* thread_;
};

/// The arguments of a call.
class Arguments {
public:
    /// \throws ErrorIsSet, a TypeError, when there are not `count`.
    Arguments(PyObject* tuple, Py_ssize_t count);

    /// An argument, borrowed.
    PyObject* Get(Py_ssize_t i) const { return PyTuple_GetItem(tuple_, i); }
    /// A text, valid as long as the arguments.
    const char* GetText(Py_ssize_t i);
    /// A text; null for None.
    const char* GetTextOrNull(Py_ssize_t i) { return Get(i) == Py_None ? nullptr : GetText(i); }
    /// An integer.
    long GetInt(Py_ssize_t i) const;
    /// Whether an argument is true.
    bool GetBool(Py_ssize_t i) const;

private:
    PyObject* tuple_;
    std::array<Text, 8> texts_;
};

/// Whether a function uses the engine all the time, or runs code of Python that may use it too.
enum class Uses { Always, AtTimes };

/// A function of a model as Python calls it.
template <Ref (*Function)(ModelState&, Arguments&), int Count, Uses UsesEngine>
PyObject* Call(PyObject* self, PyObject* tuple) noexcept {
    try {
        ModelState& state = *reinterpret_cast<ModelObject*>(self)->state;
        Arguments arguments(tuple, Count);
        if constexpr (UsesEngine == Uses::AtTimes) {
            return Function(state, arguments).Release();
        } else {
            const Use use(state.GetEngine());
            return Function(state, arguments).Release();
        }
    } catch (...) {
        SetError();
        return nullptr;
    }
}

/// The row of a function of a model.
template <Ref (*Function)(ModelState&, Arguments&), int Count, Uses UsesEngine = Uses::Always>
constexpr PyMethodDef Row(const char* name) {
    return {name, &Call<Function, Count, UsesEngine>, METH_VARARGS, nullptr};
}

/// The texts of a list of str.
std::vector<std::string> TakeTexts(PyObject* list);

/// Registers the types of this extension in its module.
void AddEngineType(PyObject* module);
void AddModelType(PyObject* module);
void AddWalkTypes();
/// Makes the type that a specification describes.
PyTypeObject* MakeType(PyType_Spec& spec);
/// Makes an object of a type, all bytes of it 0.
PyObject* Allocate(PyTypeObject* type);
/// Frees an object whose state has been destroyed.
void Free(PyObject* object) noexcept;

/// The functions of a model, one table a topic; each ends in an empty row.
extern const std::vector<PyMethodDef> BuildingMethods;
extern const std::vector<PyMethodDef> ReadingMethods;
extern const std::vector<PyMethodDef> AttributeMethods;
extern const std::vector<PyMethodDef> OptionMethods;
extern const std::vector<PyMethodDef> FileMethods;
extern const std::vector<PyMethodDef> BulkMethods;

} // namespace Python
