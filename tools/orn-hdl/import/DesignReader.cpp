#include "import/DesignReader.h"

#include "import/CellReader.h"
#include "import/JsonWalker.h"
#include "import/PartReader.h"

#include <cstddef>
#include <string_view>
#include <utility>

namespace Tool::Import {

namespace {

class DesignReader {
public:
    DesignReader(ImportedDesign& design, bool keepAttributes, std::size_t fileSize)
        : design_(design), keepAttributes_(keepAttributes), parts_(design, walker_, fileSize),
          cells_(design, walker_, parts_, keepAttributes) {}

    void Read(std::string text);

private:
    void ReadFile(JsonValue& root);
    void ReadModule(std::string_view name, JsonValue& value);
    void ReadModulePart(Module& module, std::string_view key, JsonValue& part);
    void ReadModuleAttributes(Module& module, JsonValue& value);
    void ReadDefaults(Module& module, JsonValue& value);
    void ReadMemories(Module& module, JsonValue& value);
    void ReadPort(Module& module, std::string_view name, JsonValue& value);
    void ReadNet(Module& module, std::string_view name, JsonValue& value);

    ImportedDesign& design_;
    const bool keepAttributes_;
    JsonWalker walker_;
    PartReader parts_;
    CellReader cells_;
};

void DesignReader::Read(std::string text) {
    walker_.Walk(std::move(text), [this](JsonValue& root) { ReadFile(root); });
}

void DesignReader::ReadFile(JsonValue& root) {
    bool hasModules = false;
    walker_.ForEachField(root, [&](std::string_view key, JsonValue& value) {
        if (key == "modules") {
            hasModules = true;
            parts_.ForEachNamed(value, [this](std::string_view name, JsonValue& module) {
                ReadModule(name, module);
            });
        } else {
            walker_.Skip(value);
        }
    });
    if (!hasModules) {
        walker_.Fail("not a netlist: \"modules\" is missing");
    }
}

void DesignReader::ReadModule(std::string_view name, JsonValue& value) {
    Module& module = design_.modules.emplace_back();
    module.name = name;
    parts_.StartModule();
    walker_.ForEachField(
        value, [&](std::string_view key, JsonValue& part) { ReadModulePart(module, key, part); });
    module.netBits = parts_.CountNetBits();
}

void DesignReader::ReadModulePart(Module& module, std::string_view key, JsonValue& part) {
    if (key == "attributes") {
        ReadModuleAttributes(module, part);
    } else if (key == "parameter_default_values") {
        ReadDefaults(module, part);
    } else if (key == "ports") {
        parts_.ForEachNamed(
            part, [&](std::string_view name, JsonValue& port) { ReadPort(module, name, port); });
    } else if (key == "cells") {
        parts_.ForEachNamed(
            part, [&](std::string_view name, JsonValue& cell) { cells_.Read(module, name, cell); });
    } else if (key == "netnames") {
        parts_.ForEachNamed(
            part, [&](std::string_view name, JsonValue& net) { ReadNet(module, name, net); });
    } else if (key == "memories") {
        ReadMemories(module, part);
    } else {
        walker_.Skip(part);
    }
}

void DesignReader::ReadModuleAttributes(Module& module, JsonValue& value) {
    walker_.ForEachField(value, [&](std::string_view key, JsonValue& attribute) {
        const Value read = parts_.ReadValue(attribute);
        const bool isSet = read.kind == Value::Integer
                               ? read.integer != 0
                               : read.text.find_first_not_of("0xz") != std::string_view::npos;
        module.blackBox |= isSet && (key == "blackbox" || key == "whitebox");
        module.top |= isSet && key == "top";
    });
}

void DesignReader::ReadDefaults(Module& module, JsonValue& value) {
    walker_.ForEachField(value, [&](std::string_view parameter, JsonValue& defaultValue) {
        module.defaults.push_back(
            NamedValue{design_.Keep(parameter), parts_.ReadValue(defaultValue)});
    });
}

void DesignReader::ReadMemories(Module& module, JsonValue& value) {
    walker_.ForEachField(value, [&](std::string_view, JsonValue& memory) {
        module.hasMemories = true;
        walker_.Skip(memory);
    });
}

void DesignReader::ReadPort(Module& module, std::string_view name, JsonValue& value) {
    ModulePort port;
    port.name = name;
    walker_.ForEachField(value, [&](std::string_view key, JsonValue& part) {
        if (key == "direction") {
            port.direction = parts_.ReadDirection(part);
        } else if (key == "bits") {
            port.bits = parts_.ReadBits(module, part);
        } else if (!parts_.ReadRange(key, part, port.range)) {
            walker_.Skip(part);
        }
    });
    if (port.direction == Direction::Unspecified) {
        walker_.Fail("a port needs a direction");
    }
    if (port.bits.count == 0) {
        walker_.Fail("a port needs at least one bit");
    }
    module.ports.push_back(port);
}

void DesignReader::ReadNet(Module& module, std::string_view name, JsonValue& value) {
    Net net;
    net.name = name;
    walker_.ForEachField(value, [&](std::string_view key, JsonValue& part) {
        if (key == "hide_name") {
            net.hidden = walker_.ReadFlag(part);
        } else if (key == "bits") {
            net.bits = parts_.ReadBits(module, part);
        } else if (key == "attributes" && keepAttributes_) {
            net.attributes = parts_.ReadValues(module, part);
        } else if (!parts_.ReadRange(key, part, net.range)) {
            walker_.Skip(part);
        }
    });
    module.nets.push_back(net);
}

} // namespace

std::unique_ptr<ImportedDesign> ReadDesign(std::string text, bool keepAttributes) {
    auto design = std::make_unique<ImportedDesign>();
    const std::size_t size = text.size();
    DesignReader(*design, keepAttributes, size).Read(std::move(text));
    return design;
}

} // namespace Tool::Import
