// The functions of the C interface for options.
#include "C/Calls.h"
#include "C/Texts.h"

namespace CInterface = Orn_Hdl::CInterface;

using CInterface::Require;
using Orn_Hdl::HdlOptions;
using Orn_Hdl::StringArray;

namespace {

/// The option as a switch; null when it is none.
bool* FindSwitch(HdlOptions& options, orn_hdl_option_t option) noexcept {
    switch (option) {
    case ORN_HDL_VHDL_SUPPRESS_CONFIGURATION:
        return &options.vhdl.suppressConfiguration;
    case ORN_HDL_VHDL_FLATTEN_BUS:
        return &options.vhdl.flattenBus;
    case ORN_HDL_VHDL_USE_DEFAULT_LIBRARY:
        return &options.vhdl.useDefaultLibrary;
    case ORN_HDL_VHDL_USE_ATTRIBUTE_TYPE:
        return &options.vhdl.useAttrType;
    case ORN_HDL_VHDL_OPEN_PIN:
        return &options.vhdl.openPin;
    case ORN_HDL_VHDL_SUPPRESS_COMPONENT:
        return &options.vhdl.suppressComponent;
    case ORN_HDL_WRITE_HEADER:
        return &options.writeHeader;
    case ORN_HDL_ONE_PORT_PER_LINE:
        return &options.onePortPerLine;
    case ORN_HDL_HIERARCHICAL_INIT:
        return &options.hierarchicalInit;
    case ORN_HDL_LEGAL:
        return &options.legal;
    case ORN_HDL_ESCAPE_NAMES:
        return &options.escapeNames;
    case ORN_HDL_VERIFY:
        return &options.verify;
    case ORN_HDL_DONT_CARES:
        return &options.dontCares;
    default:
        return nullptr;
    }
}

/// The option as a letter case; null when it is none.
HdlOptions::VerilogOption::CaseType* FindCase(HdlOptions& options,
                                              orn_hdl_option_t option) noexcept {
    switch (option) {
    case ORN_HDL_VERILOG_SIGNAL_CASE:
        return &options.verilog.signalCase;
    case ORN_HDL_VERILOG_INSTANCE_CASE:
        return &options.verilog.instanceCase;
    case ORN_HDL_VERILOG_COMPONENT_CASE:
        return &options.verilog.componentCase;
    default:
        return nullptr;
    }
}

/// The option as a text; null when it is none.
Port::String* FindText(HdlOptions& options, orn_hdl_option_t option) noexcept {
    switch (option) {
    case ORN_HDL_APPLICATION:
        return &options.application;
    case ORN_HDL_COMMAND:
        return &options.command;
    case ORN_HDL_DEVICE:
        return &options.device;
    case ORN_HDL_PURPOSE:
        return &options.purpose;
    case ORN_HDL_REFERENCE:
        return &options.reference;
    default:
        return nullptr;
    }
}

/// The option as a list; null when it is none.
StringArray* FindList(HdlOptions& options, orn_hdl_option_t option) noexcept {
    switch (option) {
    case ORN_HDL_VHDL_LIBRARIES:
        return &options.vhdl.libraries;
    case ORN_HDL_VHDL_USE_CLAUSES:
        return &options.vhdl.useClauses;
    case ORN_HDL_VERILOG_INCLUDES:
        return &options.verilog.includePaths;
    default:
        return nullptr;
    }
}

int GetNumber(HdlOptions& options, orn_hdl_option_t option) {
    if (const bool* const onOrOff = FindSwitch(options, option)) {
        return *onOrOff ? 1 : 0;
    }
    if (const auto* const letterCase = FindCase(options, option)) {
        return *letterCase - HdlOptions::VerilogOption::DEFSULT;
    }
    if (option == ORN_HDL_THREADS) {
        return static_cast<int>(options.threads);
    }
    Require(option == ORN_HDL_VERILOG_SYNTHESIS);
    return options.verilog.synthesisType;
}

void SetNumber(HdlOptions& options, orn_hdl_option_t option, int value) {
    if (bool* const onOrOff = FindSwitch(options, option)) {
        Require(value == 0 || value == 1);
        *onOrOff = value == 1;
    } else if (auto* const letterCase = FindCase(options, option)) {
        Require(value >= ORN_HDL_CASE_KEPT && value <= ORN_HDL_CASE_LOWER);
        *letterCase = static_cast<HdlOptions::VerilogOption::CaseType>(
            HdlOptions::VerilogOption::DEFSULT + value);
    } else if (option == ORN_HDL_THREADS) {
        Require(value >= 0);
        options.threads = static_cast<unsigned>(value);
    } else {
        Require(option == ORN_HDL_VERILOG_SYNTHESIS && value >= HdlOptions::VerilogOption::QSN &&
                value <= HdlOptions::VerilogOption::PRECISION);
        options.verilog.synthesisType = value;
    }
}

std::string_view GetText(HdlOptions& options, orn_hdl_option_t option, size_t index) {
    const Port::String* const text = FindText(options, option);
    const StringArray* const list = FindList(options, option);
    Require(text != nullptr || list != nullptr);
    const size_t size = list == nullptr ? 1 : static_cast<size_t>(list->GetSize());
    if (index >= size) {
        CInterface::End(ORN_HDL_END);
    }
    return list == nullptr ? text->GetView() : list->GetView(static_cast<int>(index));
}

void SetText(HdlOptions& options, orn_hdl_option_t option, const char* value) {
    if (Port::String* const text = FindText(options, option)) {
        *text = value;
        return;
    }
    StringArray* const list = FindList(options, option);
    Require(list != nullptr);
    if (value == nullptr) {
        list->Empty();
    } else {
        list->Add(value);
    }
}

} // namespace

extern "C" {

orn_hdl_status_t orn_hdl_model_get_number(orn_hdl_model_t model, orn_hdl_option_t option,
                                          int* value) {
    return CInterface::LookAt(model, [&](const CInterface::ModelEntity& entity) {
        Require(value != nullptr);
        *value = GetNumber(*entity.model.GetOptions(), option);
    });
}

orn_hdl_status_t orn_hdl_model_set_number(orn_hdl_model_t model, orn_hdl_option_t option,
                                          int value) {
    return CInterface::Change(
        model, [&](Orn_Hdl::Model& target) { SetNumber(*target.GetOptions(), option, value); });
}

orn_hdl_status_t orn_hdl_model_get_text(orn_hdl_model_t model, orn_hdl_option_t option,
                                        size_t index, orn_hdl_text_t* value) {
    return CInterface::LookAt(model, [&](const CInterface::ModelEntity& entity) {
        Require(value != nullptr);
        CInterface::HandOutText(*value, GetText(*entity.model.GetOptions(), option, index));
    });
}

orn_hdl_status_t orn_hdl_model_set_text(orn_hdl_model_t model, orn_hdl_option_t option,
                                        const char* value) {
    return CInterface::Change(
        model, [&](Orn_Hdl::Model& target) { SetText(*target.GetOptions(), option, value); });
}

} // extern "C"
