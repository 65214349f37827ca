// Functions for many objects in one call.
#include "Objects.h"

#include <algorithm>
#include <cstring>
#include <string>

namespace Python {

namespace {

using Orn_Hdl::Model;

/// One column of a table of names: a str that stands in every row, an iterable of str, or a pair of
/// a list of str and the bytes of 64-bit indices into it.
class Column {
public:
    explicit Column(PyObject* column) {
        if (PyUnicode_Check(column) != 0) {
            current_ = Text(column);
        } else if (PyTuple_Check(column) != 0) {
            TakeTable(column);
        } else {
            rows_ = Ref::Take(PyObject_GetIter(column));
        }
    }

    /// Whether the column has no end of its own.
    bool IsConstant() const noexcept { return !rows_ && indices_ == nullptr; }
    /// Whether `Next` runs no code of Python.
    bool IsPlain() const noexcept { return !rows_; }

    /// Goes to the next row. \return false at the end.
    bool Next() {
        if (IsConstant()) {
            return true;
        }
        if (!rows_) {
            return NextIndex();
        }
        PyObject* const row = PyIter_Next(rows_.Get());
        if (row == nullptr) {
            if (PyErr_Occurred() != nullptr) {
                throw ErrorIsSet();
            }
            return false;
        }
        const Ref owned = Ref::Take(row);
        current_ = Text(row);
        return true;
    }
    /// The text in the present row.
    const char* Get() const noexcept { return name_ != nullptr ? name_ : current_.Get(); }

private:
    void TakeTable(PyObject* column) {
        PyObject* const names = PyTuple_GetItem(column, 0);
        PyObject* const bytes = names == nullptr ? nullptr : PyTuple_GetItem(column, 1);
        if (bytes == nullptr || PyBytes_Check(bytes) == 0) {
            PyErr_SetString(PyExc_TypeError,
                            "a column is a str, an iterable or names with indices");
            throw ErrorIsSet();
        }
        const Py_ssize_t size = PyList_Size(names);
        if (size < 0) {
            throw ErrorIsSet();
        }
        for (Py_ssize_t i = 0; i < size; ++i) {
            names_.emplace_back(Text(PyList_GetItem(names, i)).GetView());
        }
        indexBytes_ = Ref::Share(bytes);
        indices_ = PyBytes_AsString(bytes);
        count_ = static_cast<std::size_t>(PyBytes_Size(bytes)) / sizeof(std::int64_t);
    }

    bool NextIndex() {
        if (row_ == count_) {
            return false;
        }
        std::int64_t index = 0;
        std::memcpy(&index, indices_ + row_ * sizeof index, sizeof index);
        ++row_;
        if (index < 0 || static_cast<std::size_t>(index) >= names_.size()) {
            throw Failure{"index", "The index " + std::to_string(index) + " is out of range.\n"};
        }
        name_ = names_[static_cast<std::size_t>(index)].c_str();
        return true;
    }

    Text current_;
    Ref rows_;
    std::vector<std::string> names_;
    Ref indexBytes_;
    const char* indices_ = nullptr;
    std::size_t count_ = 0;
    std::size_t row_ = 0;
    const char* name_ = nullptr;
};

/// Some columns that are walked together.
class Table {
public:
    void Add(PyObject* column) { columns_.push_back(std::make_unique<Column>(column)); }

    bool IsPlain() const noexcept {
        return std::all_of(columns_.begin(), columns_.end(),
                           [](const auto& column) { return column->IsPlain(); });
    }
    /// Goes to the next row. \return false when all columns are at their end.
    /// \throws Failure "length" when only some are.
    bool Next() {
        std::size_t ended = 0;
        std::size_t counted = 0;
        for (const auto& column : columns_) {
            if (!column->IsConstant()) {
                ++counted;
                ended += column->Next() ? 0U : 1U;
            }
        }
        if (counted == 0) {
            throw Failure{"length", "One of the columns has to be more than a single name.\n"};
        }
        if (ended != 0 && ended != counted) {
            throw Failure{"length", "The columns differ in length.\n"};
        }
        return ended == 0;
    }
    const char* Get(std::size_t column) const noexcept { return columns_[column]->Get(); }

private:
    std::vector<std::unique_ptr<Column>> columns_;
};

/// Does something for every row. \return how many rows there are.
template <class Action> Ref ForEachRow(ModelState& state, Table& table, const Action& action) {
    long long rows = 0;
    if (table.IsPlain()) {
        const Use use(state.GetEngine());
        Model& model = state.Get();
        const Unlocked unlocked;
        for (; table.Next(); ++rows) {
            action(model, table);
        }
    } else {
        // The rows may come from code of Python that uses the design too.
        for (; table.Next(); ++rows) {
            const Use use(state.GetEngine());
            action(state.Get(), table);
        }
    }
    return MakeInt(rows);
}

/// Names, components.
Ref AddInstances(ModelState& state, Arguments& arguments) {
    Table table;
    table.Add(arguments.Get(0));
    table.Add(arguments.Get(1));
    return ForEachRow(state, table, [](Model& model, const Table& row) {
        model.AddInstance(row.Get(0), row.Get(1));
    });
}

/// Signals, instances, pins.
Ref ConnectMany(ModelState& state, Arguments& arguments) {
    Table table;
    table.Add(arguments.Get(0));
    table.Add(arguments.Get(1));
    table.Add(arguments.Get(2));
    return ForEachRow(state, table, [](Model& model, const Table& row) {
        model.ConnectSignalToPin(row.Get(0), row.Get(1), row.Get(2));
    });
}

Ref AddSignals(ModelState& state, Arguments& arguments) {
    Table table;
    table.Add(arguments.Get(0));
    return ForEachRow(state, table,
                      [](Model& model, const Table& row) { model.AddSignal(row.Get(0)); });
}

/// Numbers signals in the order in which they first occur, in a table of open addresses: a design
/// has millions of connections, and the table is what they cost.
class SignalNumbers {
public:
    /// The number of a signal.
    std::int32_t Number(const Orn_Hdl::Signal& signal) {
        if (2 * names_.size() >= slots_.size()) {
            Grow();
        }
        Slot& slot = Find(&signal);
        if (slot.signal == nullptr) {
            slot = {&signal, static_cast<std::int32_t>(names_.size())};
            names_.push_back(signal.GetNameView());
        }
        return slot.number;
    }
    const std::vector<std::string_view>& GetNames() const noexcept { return names_; }

private:
    struct Slot {
        const Orn_Hdl::Signal* signal = nullptr;
        std::int32_t number = 0;
    };

    /// The slot of a signal, or the free one that it would get.
    Slot& Find(const Orn_Hdl::Signal* signal) noexcept {
        constexpr std::uint64_t Spread = 0x9E3779B97F4A7C15U;
        constexpr unsigned UpperHalf = 32;
        std::uint64_t place = (reinterpret_cast<std::uintptr_t>(signal) * Spread) >> UpperHalf;
        for (;; ++place) {
            Slot& slot = slots_[place & (slots_.size() - 1)];
            if (slot.signal == signal || slot.signal == nullptr) {
                return slot;
            }
        }
    }

    void Grow() {
        constexpr std::size_t Least = 1024;
        std::vector<Slot> former(std::max(Least, 4 * slots_.size()));
        former.swap(slots_);
        for (const Slot& slot : former) {
            if (slot.signal != nullptr) {
                Find(slot.signal) = slot;
            }
        }
    }

    std::vector<Slot> slots_;
    std::vector<std::string_view> names_;
};

Ref MakeNames(const std::vector<std::string_view>& names) {
    Ref list = MakeList();
    for (const std::string_view name : names) {
        Append(list, MakeText(name));
    }
    return list;
}

Ref MakeBytes(const std::vector<std::int32_t>& numbers) {
    return Ref::Take(
        PyBytes_FromStringAndSize(reinterpret_cast<const char*>(numbers.data()),
                                  static_cast<Py_ssize_t>(numbers.size() * sizeof(std::int32_t))));
}

/// Names of signals, instances and pins, then for each connection the three numbers as 32 bits
/// each.
Ref GetConnections(ModelState& state, Arguments& /*arguments*/) {
    const Orn_Hdl::Netlist& netlist = state.GetNetlist();
    SignalNumbers numbers;
    std::vector<std::string_view> instanceNames;
    std::unordered_map<std::string_view, std::int32_t> pinNumbers;
    std::vector<std::string_view> pinNames;
    std::vector<std::int32_t> signals;
    std::vector<std::int32_t> instances;
    std::vector<std::int32_t> pins;
    {
        const Unlocked unlocked;
        for (const Orn_Hdl::Instance* const instance : netlist.GetInstanceIterator()) {
            const auto number = static_cast<std::int32_t>(instanceNames.size());
            instanceNames.push_back(instance->GetNameView());
            for (const Orn_Hdl::Pin* const pin : instance->GetPinIterator()) {
                const Orn_Hdl::Signal* const signal = pin->GetSignal();
                if (signal == nullptr) {
                    continue;
                }
                const auto [found, isNew] = pinNumbers.emplace(
                    pin->GetNameView(), static_cast<std::int32_t>(pinNames.size()));
                if (isNew) {
                    pinNames.push_back(pin->GetNameView());
                }
                signals.push_back(numbers.Number(*signal));
                instances.push_back(number);
                pins.push_back(found->second);
            }
        }
    }
    return MakeTuple(MakeNames(numbers.GetNames()), MakeNames(instanceNames), MakeNames(pinNames),
                     MakeBytes(signals), MakeBytes(instances), MakeBytes(pins));
}

} // namespace

const std::vector<PyMethodDef> BulkMethods = {
    Row<AddInstances, 2, Uses::AtTimes>("add_instances"),
    Row<ConnectMany, 3, Uses::AtTimes>("connect_many"),
    Row<AddSignals, 1, Uses::AtTimes>("add_signals"),
    Row<GetConnections, 0>("connections"),
};

} // namespace Python
