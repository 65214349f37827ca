#include "Walks.h"

#include <string>
#include <unordered_map>

namespace Python {

namespace {

/// Where a walk is.
class Walk {
public:
    explicit Walk(ModelState& model) : netlists_(model.netlists) {}
    Walk(const Walk&) = delete;
    Walk& operator=(const Walk&) = delete;
    virtual ~Walk() = default;

    /// The next item; none at the end.
    Ref Next(const ModelState& model) {
        const Orn_Hdl::Netlist& netlist = model.GetNetlist();
        if (netlists_ != model.netlists) {
            throw Failure{"changed", "The design has been replaced during the iteration.\n"};
        }
        return Step(netlist);
    }

private:
    virtual Ref Step(const Orn_Hdl::Netlist& netlist) = 0;

    std::uint64_t netlists_;
};

template <class Object> class ObjectWalk final : public Walk {
public:
    ObjectWalk(ModelState& model, const Orn_Hdl::Iterator<Object*>& place)
        : Walk(model), place_(place) {}

private:
    Ref Step(const Orn_Hdl::Netlist& /*netlist*/) override {
        for (; !place_.IsAtEnd(); place_.Next()) {
            const Object* const object = place_.GetCurrent();
            if (object == nullptr) {
                continue;
            }
            if constexpr (std::is_same_v<Object, Orn_Hdl::Signal>) {
                if (object->IsNeededToDeclared()) {
                    Ref found = DescribeSignal(*object);
                    place_.Next();
                    return found;
                }
            } else {
                Ref found = MakeText(object->GetNameView());
                place_.Next();
                return found;
            }
        }
        return Ref();
    }

    Orn_Hdl::Iterator<Object*> place_;
};

/// Takes some instances at a time, so that their signals can be fetched ahead.
class ConnectionWalk final : public Walk {
public:
    ConnectionWalk(ModelState& model, const Orn_Hdl::Iterator<Orn_Hdl::Instance*>& place)
        : Walk(model), place_(place) {}

private:
    /// A connected pin; valid while nothing of Python runs.
    struct Connection {
        const Orn_Hdl::Signal* signal;
        const Orn_Hdl::Instance* instance;
        const Orn_Hdl::Pin* pin;
    };

    Ref Step(const Orn_Hdl::Netlist& /*netlist*/) override {
        if (given_ == made_.size()) {
            Fill();
        }
        return given_ == made_.size() ? Ref() : std::move(made_[given_++]);
    }

    void Fill() {
        constexpr std::size_t AtOnce = 256;
        std::vector<Connection> connections;
        while (connections.size() < AtOnce && !place_.IsAtEnd()) {
            const Orn_Hdl::Instance* const instance = place_.GetCurrent();
            place_.Next();
            if (instance == nullptr) {
                continue;
            }
            for (const Orn_Hdl::Pin* const pin : instance->GetPinIterator()) {
                if (const Orn_Hdl::Signal* const signal = pin->GetSignal()) {
                    __builtin_prefetch(signal);
                    connections.push_back({signal, instance, pin});
                }
            }
        }
        made_.clear();
        given_ = 0;
        const Orn_Hdl::Instance* named = nullptr;
        Ref name;
        for (const Connection& connection : connections) {
            if (connection.instance != named) {
                named = connection.instance;
                name = MakeText(named->GetNameView());
            }
            made_.push_back(MakeTuple(MakeText(connection.signal->GetNameView()),
                                      Ref::Share(name.Get()), NameOf(*connection.pin)));
        }
    }

    /// There are few different names of pins.
    Ref NameOf(const Orn_Hdl::Pin& pin) {
        constexpr std::size_t MostKept = 4096;
        const std::string_view name = pin.GetNameView();
        const auto found = pinNames_.find(name);
        if (found != pinNames_.end()) {
            return Ref::Share(found->second.second.Get());
        }
        Ref text = MakeText(name);
        if (pinNames_.size() < MostKept) {
            auto copy = std::make_unique<std::string>(name);
            const std::string_view key = *copy;
            pinNames_.emplace(key, std::pair(std::move(copy), Ref::Share(text.Get())));
        }
        return text;
    }

    Orn_Hdl::Iterator<Orn_Hdl::Instance*> place_;
    std::vector<Ref> made_;
    std::size_t given_ = 0;
    std::unordered_map<std::string_view, std::pair<std::unique_ptr<std::string>, Ref>> pinNames_;
};

/// The type of walks.
struct WalkObject {
    PyObject_HEAD
        /// Keeps the model's state alive.
        PyObject* model;
    /// Owned; null when the walk is over.
    Walk* walk;
};

PyTypeObject* walkType = nullptr;

void DeallocateWalk(PyObject* self) noexcept {
    auto* const object = reinterpret_cast<WalkObject*>(self);
    delete object->walk;
    Py_XDECREF(object->model);
    Free(self);
}

PyObject* NextOfWalk(PyObject* self) noexcept {
    auto* const object = reinterpret_cast<WalkObject*>(self);
    if (object->walk == nullptr) {
        return nullptr;
    }
    try {
        const ModelState& model = *reinterpret_cast<ModelObject*>(object->model)->state;
        const Use use(model.GetEngine());
        Ref item = object->walk->Next(model);
        if (!item) {
            delete std::exchange(object->walk, nullptr);
        }
        return item.Release();
    } catch (...) {
        SetError();
        return nullptr;
    }
}

} // namespace

void AddWalkTypes() {
    static PyType_Slot slots[] = {{Py_tp_dealloc, reinterpret_cast<void*>(&DeallocateWalk)},
                                  {Py_tp_iter, reinterpret_cast<void*>(&PyObject_SelfIter)},
                                  {Py_tp_iternext, reinterpret_cast<void*>(&NextOfWalk)},
                                  {0, nullptr}};
    static PyType_Spec spec = {"orn_hdl._orn_hdl.Walk", sizeof(WalkObject), 0, Py_TPFLAGS_DEFAULT,
                               slots};
    walkType = MakeType(spec);
}

namespace {

Ref MakeWalkObject(ModelState& model, std::unique_ptr<Walk> walk) {
    Ref object = Ref::Take(Allocate(walkType));
    auto* const fields = reinterpret_cast<WalkObject*>(object.Get());
    fields->model = Ref::Share(model.self).Release();
    fields->walk = walk.release();
    return object;
}

} // namespace

Ref MakeWalk(ModelState& model, Kind kind) {
    const Orn_Hdl::Netlist& netlist = model.GetNetlist();
    std::unique_ptr<Walk> walk;
    if (kind == Kind::Component) {
        walk =
            std::make_unique<ObjectWalk<Orn_Hdl::Component>>(model, netlist.GetComponentIterator());
    } else if (kind == Kind::Instance) {
        walk =
            std::make_unique<ObjectWalk<Orn_Hdl::Instance>>(model, netlist.GetInstanceIterator());
    } else {
        walk = std::make_unique<ObjectWalk<Orn_Hdl::Signal>>(model, netlist.GetSignalIterator());
    }
    return MakeWalkObject(model, std::move(walk));
}

Ref MakeConnectionWalk(ModelState& model) {
    const Orn_Hdl::Netlist& netlist = model.GetNetlist();
    return MakeWalkObject(model,
                          std::make_unique<ConnectionWalk>(model, netlist.GetInstanceIterator()));
}

} // namespace Python
