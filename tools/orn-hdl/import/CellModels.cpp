#include "import/CellModels.h"

#include "import/CellModelTexts.h"
#include "import/Spelling.h"

#include "Port/Ascii.h"

#include <algorithm>
#include <cstddef>
#include <set>
#include <string>
#include <string_view>
#include <unordered_map>
#include <utility>

namespace Tool::Import {

namespace {

/// What the names of the models of word-level cells begin with.
constexpr std::string_view ModelPrefix = "orn_hdl_";
constexpr std::string_view PackageKey = "package";

/// The model of one cell, as text.
class CellModel {
public:
    explicit CellModel(std::string_view text) : text_(text) {}

    std::string_view GetText() const noexcept { return text_; }
    std::string_view GetEntity() const {
        constexpr std::string_view Before = "\nentity ";
        const std::size_t start = text_.find(Before) + Before.size();
        return text_.substr(start, text_.find(' ', start) - start);
    }
    /// The type of a port or generic; empty if there is none.
    std::string_view GetTypeOf(std::string_view name) const {
        const std::size_t place = text_.find("\n      " + std::string(name) + " : ");
        if (place == std::string_view::npos) {
            return {};
        }
        std::string_view type = text_.substr(text_.find(" : ", place) + 3);
        for (const std::string_view direction : {"in ", "out "}) {
            if (type.substr(0, direction.size()) == direction) {
                type.remove_prefix(direction.size());
            }
        }
        return type.substr(0, type.find_first_of(" (;\n"));
    }

private:
    std::string_view text_;
};

using CellModelMap = std::unordered_map<std::string_view, CellModel>;

/// The models of a file, by the type of cell that the first line of each tells.
CellModelMap SplitModels(std::string_view file) {
    constexpr std::string_view Mark = "\n\n-- ";
    CellModelMap result;
    for (std::size_t start = file.find(Mark); start != std::string_view::npos;) {
        const std::size_t end = file.find(Mark, start + 1);
        const std::string_view text = file.substr(start + 2, end - start - 1);
        const std::size_t key = Mark.size() - 2;
        result.emplace(text.substr(key, text.find(':') - key), CellModel(text));
        start = end;
    }
    return result;
}

bool IsPartOfName(char c) noexcept {
    return Port::IsLetter(c) || Port::IsDigit(c) || c == '_';
}

/// A text with another name in the place of each occurrence of a name.
std::string ReplaceName(std::string_view text, std::string_view name, std::string_view newName) {
    std::string result;
    std::size_t copied = 0;
    for (std::size_t place = text.find(name); place != std::string_view::npos;
         place = text.find(name, place + 1)) {
        const std::size_t end = place + name.size();
        if (!IsPartOfName(text[place - 1]) && !IsPartOfName(text[end])) {
            result.append(text, copied, place - copied).append(newName);
            copied = end;
        }
    }
    return result.append(text.substr(copied));
}

std::string_view GetVhdlType(const ImportedGeneric& generic) noexcept {
    return generic.value.type == "BitVector" ? "bit_vector"
           : generic.value.type == "Integer" ? "integer"
                                             : "string";
}

/// A list in which all but the last entries end with a separator.
void WriteList(const std::vector<std::string>& entries, std::string_view separator,
               std::string_view indentation, Port::Stream& out) {
    for (std::size_t i = 0; i < entries.size(); ++i) {
        out << indentation << entries[i] << (i + 1 < entries.size() ? separator : "") << "\n";
    }
}

/// An entity with the ports and generics of a component, which consists of a model.
class Adapter {
public:
    Adapter(const ImportedComponent& component, const CellModel& model);

    void Write(Port::Stream& out) const;

private:
    void AddGeneric(const ImportedGeneric& generic, const CellModel& model);
    void AddPin(const ImportedPin& pin, const CellModel& model);

    const std::string& name_;
    const std::string_view type_;
    const std::string_view entity_;
    std::vector<std::string> generics_;
    std::vector<std::string> genericMap_;
    std::vector<std::string> ports_;
    std::vector<std::string> portMap_;
};

Adapter::Adapter(const ImportedComponent& component, const CellModel& model)
    : name_(component.name), type_(component.oldName), entity_(model.GetEntity()) {
    for (const ImportedGeneric& generic : component.generics) {
        AddGeneric(generic, model);
    }
    for (const ImportedPin& pin : component.pins) {
        AddPin(pin, model);
    }
}

void Adapter::AddGeneric(const ImportedGeneric& generic, const CellModel& model) {
    const std::string_view type = GetVhdlType(generic);
    generics_.push_back(std::string(generic.value.name).append(" : ").append(type));
    const std::string_view wanted = model.GetTypeOf(generic.oldName);
    // Any other text is a name for people alone.
    if (wanted.empty() || (type == "string") != (wanted == "string")) {
        return;
    }
    const std::string_view conversion = type == "integer" ? "work.orn_hdl_cells.bits_of(" : "";
    genericMap_.push_back(std::string(generic.oldName)
                              .append(" => ")
                              .append(conversion)
                              .append(generic.value.name)
                              .append(conversion.empty() ? "" : ")"));
}

void Adapter::AddPin(const ImportedPin& pin, const CellModel& model) {
    const bool isBitOfBus = pin.scalar && model.GetTypeOf(pin.oldName) == "std_logic_vector";
    const std::string direction = pin.direction == Direction::Output ? " : out " : " : in ";
    const std::string type =
        pin.scalar ? "std_logic"
                   : "std_logic_vector(" + std::to_string(pin.width - 1) + " downto 0)";
    ports_.push_back(pin.baseName + direction + type);
    // Cells that leave the pin open share a component with cells that have more bits there.
    const std::string count = std::string(pin.oldName).append("_PINS");
    if (!model.GetTypeOf(count).empty()) {
        genericMap_.push_back(count + " => " + std::to_string(pin.width));
    }
    // No signal stands between the two, so that a clock arrives without a delay.
    portMap_.push_back(std::string(pin.oldName) + (isBitOfBus ? "(0) => " : " => ") + pin.baseName);
}

void Adapter::Write(Port::Stream& out) const {
    constexpr std::string_view Indentation = "   ";
    constexpr std::string_view Twice = "      ";
    constexpr std::string_view Thrice = "         ";
    out << "\n-- Cells of the type " << type_ << ".\n"
        << "library ieee;\nuse ieee.std_logic_1164.all;\n\nentity " << name_ << " is\n";
    if (!generics_.empty()) {
        out << Indentation << "generic (\n";
        WriteList(generics_, ";", Twice, out);
        out << Indentation << ");\n";
    }
    out << Indentation << "port (\n";
    WriteList(ports_, ";", Twice, out);
    out << Indentation << ");\nend " << name_ << ";\n\narchitecture model of " << name_
        << " is\nbegin\n   cell : entity work." << entity_ << "\n";
    if (!genericMap_.empty()) {
        out << Twice << "generic map (\n";
        WriteList(genericMap_, ",", Thrice, out);
        out << Twice << ")\n";
    }
    out << Twice << "port map (\n";
    WriteList(portMap_, ",", Thrice, out);
    out << Twice << ");\nend model;\n";
}

class ModelWriter {
public:
    ModelWriter(Port::Stream& out, Warnings& warnings)
        : out_(out), warnings_(warnings), gates_(SplitModels(GetGateModels())),
          words_(SplitModels(GetWordModels())) {}

    void Write(const ImportedNetlist& netlist);
    /// \throws Error if a name of the design is that of an entity or package written for words.
    void CheckName(std::string_view name, const JsonPath& path) const;

private:
    void WriteComponent(const ImportedComponent& component, const Module& top);
    void WriteGate(const ImportedComponent& component, const CellModel& model);
    void WriteWord(const ImportedComponent& component, const CellModel& model);
    void WriteOnce(std::string_view key);

    Port::Stream& out_;
    Warnings& warnings_;
    const CellModelMap gates_;
    const CellModelMap words_;
    /// The names of the components, and the keys of the models, that have been written.
    std::set<std::string, std::less<>> written_;
};

/// Whether a model has all pins of a component.
bool HasPins(const CellModel& model, const ImportedComponent& component) {
    return std::all_of(component.pins.begin(), component.pins.end(), [&](const ImportedPin& pin) {
        const std::string_view type = model.GetTypeOf(pin.oldName);
        return !type.empty() && (pin.scalar || type == "std_logic_vector");
    });
}

void ModelWriter::CheckName(std::string_view name, const JsonPath& path) const {
    if (Port::EqualIgnoringCase(name.substr(0, ModelPrefix.size()), ModelPrefix)) {
        Fail(path, Quote(name) + ": the models of cells have names that begin with " +
                       Quote(ModelPrefix));
    }
}

void ModelWriter::Write(const ImportedNetlist& netlist) {
    CheckName(netlist.name, JsonPath("modules").AddKey(netlist.top.name));
    for (const ImportedComponent& component : netlist.components.GetAll()) {
        CheckName(component.name,
                  netlist.top.GetPath("cells", component.firstCell->name).AddKey("type"));
        if (component.oldName.substr(0, 1) == "$" && written_.insert(component.name).second) {
            WriteComponent(component, netlist.top);
        }
    }
}

void ModelWriter::WriteComponent(const ImportedComponent& component, const Module& top) {
    const auto gate = gates_.find(component.oldName);
    const auto word = words_.find(component.oldName);
    if (gate != gates_.end() && HasPins(gate->second, component)) {
        WriteGate(component, gate->second);
    } else if (word != words_.end() && HasPins(word->second, component)) {
        WriteWord(component, word->second);
    } else if (component.oldName.substr(0, 9) != "$paramod$" &&
               component.oldName.substr(0, 9) != "$paramod\\") {
        warnings_.Add(top.GetPath("cells", component.firstCell->name).AddKey("type"),
                      "there is no simulation model of " + Quote(component.oldName) +
                          "; VHDL needs an entity " + component.name);
    }
}

void ModelWriter::WriteGate(const ImportedComponent& component, const CellModel& model) {
    out_ << "\n" << ReplaceName(model.GetText(), model.GetEntity(), component.name);
}

void ModelWriter::WriteWord(const ImportedComponent& component, const CellModel& model) {
    WriteOnce(PackageKey);
    WriteOnce(component.oldName);
    Adapter(component, model).Write(out_);
}

void ModelWriter::WriteOnce(std::string_view key) {
    // The key of a model is no name of a component, which has no "$".
    if (written_.insert("$" + std::string(key)).second) {
        out_ << "\n" << words_.at(key).GetText();
    }
}

} // namespace

bool HasModelWithFirstValue(std::string_view type) {
    static const CellModelMap gates = SplitModels(GetGateModels());
    static const CellModelMap words = SplitModels(GetWordModels());
    for (const CellModelMap* models : {&gates, &words}) {
        const auto model = models->find(type);
        // A memory has a first value for each word, which is a parameter of its own.
        if (model != models->end() && model->second.GetTypeOf("INIT") == "string") {
            return true;
        }
    }
    return false;
}

void WriteCellModels(const std::vector<ImportedNetlist>& netlists, Port::Stream& out,
                     Warnings& warnings) {
    out << "-- Simulation models of cells, by Orn_Hdl.\n";
    ModelWriter writer(out, warnings);
    for (const ImportedNetlist& netlist : netlists) {
        writer.Write(netlist);
    }
}

} // namespace Tool::Import
