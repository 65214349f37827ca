#include "import/DesignReader.h"

#include "import/CellReader.h"
#include "import/JsonWalker.h"
#include "import/PartReader.h"
#include "import/Values.h"

#include <cstddef>
#include <cstdint>
#include <string_view>
#include <utility>

namespace Tool::Import {

namespace {

/// The attribute of a net with the value that registers have before they are loaded.
constexpr std::string_view FirstValueName("init");

class DesignReader {
public:
    /// \param walk the arguments of the walker.
    template <class... Walk>
    DesignReader(ImportedDesign& design, bool keepAttributes, Walk&... walk)
        : design_(design), keepAttributes_(keepAttributes), walker_(walk...),
          parts_(design, walker_), cells_(design, walker_, parts_, keepAttributes) {}

    void Read();

private:
    void ReadFile();
    void ReadModule(std::string_view name);
    void ReadModulePart(Module& module, std::string_view key);
    void ReadModuleAttributes(Module& module);
    void ReadDefaults(Module& module);
    void ReadMemories(Module& module);
    void ReadPort(Module& module, std::string_view name);
    void ReadNet(Module& module, std::string_view name);
    void ReadNetAttributes(Module& module, Net& net);

    ImportedDesign& design_;
    const bool keepAttributes_;
    JsonWalker walker_;
    PartReader parts_;
    CellReader cells_;
};

void DesignReader::Read() {
    walker_.Walk([this] { ReadFile(); });
}

void DesignReader::ReadFile() {
    bool hasModules = false;
    walker_.ForEachField([&](std::string_view key) {
        if (key == "modules") {
            hasModules = true;
            parts_.ForEachNamed([this](std::string_view name) { ReadModule(name); });
        } else {
            walker_.Skip();
        }
    });
    if (!hasModules) {
        walker_.Fail("not a netlist: \"modules\" is missing");
    }
}

void DesignReader::ReadModule(std::string_view name) {
    Module& module = design_.modules.emplace_back();
    module.name = name;
    parts_.StartModule();
    walker_.ForEachField([&](std::string_view key) { ReadModulePart(module, key); });
    module.netBits = parts_.CountNetBits();
}

void DesignReader::ReadModulePart(Module& module, std::string_view key) {
    if (key == "attributes") {
        ReadModuleAttributes(module);
    } else if (key == "parameter_default_values") {
        ReadDefaults(module);
    } else if (key == "ports") {
        parts_.ForEachNamed([&](std::string_view name) { ReadPort(module, name); });
    } else if (key == "cells") {
        parts_.ForEachNamed([&](std::string_view name) { cells_.Read(module, name); });
    } else if (key == "netnames") {
        parts_.ForEachNamed([&](std::string_view name) { ReadNet(module, name); });
    } else if (key == "memories") {
        ReadMemories(module);
    } else {
        walker_.Skip();
    }
}

void DesignReader::ReadModuleAttributes(Module& module) {
    walker_.ForEachField([&](std::string_view key) {
        const Value read = parts_.ReadValue();
        const bool isSet = read.kind == Value::Integer
                               ? read.integer != 0
                               : read.text.find_first_not_of("0xz") != std::string_view::npos;
        module.blackBox |= isSet && (key == "blackbox" || key == "whitebox");
        module.top |= isSet && key == "top";
    });
}

void DesignReader::ReadDefaults(Module& module) {
    walker_.ForEachField([&](std::string_view parameter) {
        const std::string_view kept = parts_.KeepOnce(parameter);
        module.defaults.push_back(NamedValue{kept, parts_.ReadValue()});
    });
}

void DesignReader::ReadMemories(Module& module) {
    walker_.ForEachField([&](std::string_view) {
        module.hasMemories = true;
        walker_.Skip();
    });
}

void DesignReader::ReadPort(Module& module, std::string_view name) {
    ModulePort port;
    port.name = name;
    walker_.ForEachField([&](std::string_view key) {
        if (key == "direction") {
            port.direction = parts_.ReadDirection();
        } else if (key == "bits") {
            port.bits = parts_.ReadBits(module);
        } else if (!parts_.ReadRange(key, port.range)) {
            walker_.Skip();
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

void DesignReader::ReadNet(Module& module, std::string_view name) {
    Net net;
    net.name = name;
    walker_.ForEachField([&](std::string_view key) {
        if (key == "hide_name") {
            net.hidden = walker_.ReadFlag();
        } else if (key == "bits") {
            net.bits = parts_.ReadBits(module);
        } else if (key == "attributes") {
            ReadNetAttributes(module, net);
        } else if (!parts_.ReadRange(key, net.range)) {
            walker_.Skip();
        }
    });
    module.nets.push_back(net);
}

void DesignReader::ReadNetAttributes(Module& module, Net& net) {
    const auto note = [&](std::string_view name, const Value& value) {
        constexpr std::size_t IntegerWidth = 32;
        if (name != FirstValueName) {
            return;
        }
        // The net itself is not in its table yet.
        const auto index = static_cast<std::uint32_t>(module.nets.size());
        const std::string_view digits =
            value.kind == Value::Integer
                ? design_.Keep(MakeIntegerBits(value.integer, IntegerWidth))
                : value.text;
        if (digits.find_first_of("01") != std::string_view::npos) {
            module.firstValues.push_back(FirstValue{index, digits});
        }
    };
    if (keepAttributes_) {
        net.attributes = parts_.ReadValues(module);
        for (std::uint32_t i = 0; i < net.attributes.count; ++i) {
            const NamedValue& attribute = module.values[net.attributes.start + i];
            note(attribute.name, attribute.value);
        }
        return;
    }
    walker_.ForEachField([&](std::string_view name) {
        if (name == FirstValueName) {
            note(name, parts_.ReadValue());
        } else {
            walker_.Skip();
        }
    });
}

} // namespace

std::unique_ptr<ImportedDesign> ReadDesign(TextSource& source, bool keepAttributes) {
    auto design = std::make_unique<ImportedDesign>();
    DesignReader(*design, keepAttributes, source).Read();
    return design;
}

std::unique_ptr<ImportedDesign> ReadDesign(TextSource& source, bool keepAttributes,
                                           const TokenBatches::Settings& settings) {
    auto design = std::make_unique<ImportedDesign>();
    DesignReader(*design, keepAttributes, source, settings).Read();
    return design;
}

std::unique_ptr<ImportedDesign> ReadDesign(std::string_view text, bool keepAttributes) {
    TextInMemory source(text);
    return ReadDesign(source, keepAttributes);
}

} // namespace Tool::Import
