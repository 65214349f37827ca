#include "HdlCmd/Script/OptionScript.h"

#include "HdlCmd/Parsing.h"
#include "Verilog/Dialects.h"

namespace Orn_Hdl::Script {

namespace {

constexpr std::string_view True = "true";
constexpr std::string_view False = "false";

class OptionWriter {
public:
    explicit OptionWriter(Lines& lines) : lines_(lines), phrases_(Phrases::Get()) {}

    void WriteHeaderTexts(const HdlOptions& options) {
        WriteText(phrases_.setApplication, options.application.GetView());
        WriteText(phrases_.setCommand, options.command.GetView());
        WriteText(phrases_.setDevice, options.device.GetView());
        WriteText(phrases_.setPurpose, options.purpose.GetView());
        WriteText(phrases_.setReference, options.reference.GetView());
    }

    void WriteVerilog(const HdlOptions::VerilogOption& options) {
        const Dialect& dialect = DialectOf(options.synthesisType);
        if (dialect.type != options.synthesisType) {
            FailToExpress("option", "synthesisType", "there is no such type");
        }
        if (options.synthesisType != HdlOptions::VerilogOption().synthesisType) {
            lines_.Write(phrases_.setSynthesis, {dialect.name});
        }
        WriteCase(options.signalCase, NameKindWords::SignalInUppercase,
                  NameKindWords::SignalInLowercase);
        WriteCase(options.instanceCase, NameKindWords::Instance, NameKindWords::Instance);
        WriteCase(options.componentCase, NameKindWords::Component, NameKindWords::Component);
        WriteList(phrases_.addInclude, options.includePaths);
    }

    void WriteVhdl(const HdlOptions::VhdlOption& options) {
        const HdlOptions::VhdlOption normal;
        WriteList(phrases_.addLibrary, options.libraries);
        WriteList(phrases_.addUseLibrary, options.useClauses);
        WriteFlag(phrases_.useDefaultLibrary, options.useDefaultLibrary, normal.useDefaultLibrary);
        WriteFlag(phrases_.flattenBus, options.flattenBus, normal.flattenBus);
        WriteFlag(phrases_.suppressConfiguration, options.suppressConfiguration,
                  normal.suppressConfiguration);
        WriteFlag(phrases_.suppressComponent, options.suppressComponent, normal.suppressComponent);
        if (options.useAttrType) {
            lines_.Write(phrases_.useAttrType, {});
        }
        WriteFlag(phrases_.setOpenPin, options.openPin, normal.openPin);
    }

private:
    void WriteText(const Phrase& phrase, std::string_view text) {
        if (!text.empty()) {
            lines_.Write(phrase, {text});
        }
    }

    void WriteFlag(const Phrase& phrase, bool value, bool normal) {
        if (value != normal) {
            lines_.Write(phrase, {value ? True : False});
        }
    }

    void WriteList(const Phrase& phrase, const StringArray& texts) {
        for (const std::string_view text : texts) {
            if (text.empty()) {
                FailToExpress("an option of", phrase.text, "it is empty");
            }
            lines_.Write(phrase, {text});
        }
    }

    void WriteCase(HdlOptions::VerilogOption::CaseType nameCase, std::string_view wordInUppercase,
                   std::string_view wordInLowercase) {
        switch (nameCase) {
        case HdlOptions::VerilogOption::DEFSULT:
            break;
        case HdlOptions::VerilogOption::UPPERCASE:
            lines_.Write(phrases_.uppercase, {wordInUppercase});
            break;
        case HdlOptions::VerilogOption::LOWERCASE:
            lines_.Write(phrases_.lowercase, {wordInLowercase});
            break;
        default:
            FailToExpress("the letter case of", wordInLowercase, "there is no such case");
        }
    }

    Lines& lines_;
    const Phrases& phrases_;
};

} // namespace

void WriteOptions(const Netlist& netlist, const HdlOptions& options, Lines& lines) {
    const Phrases& phrases = Phrases::Get();
    if (netlist.GetNameView().empty()) {
        FailToExpress("the netlist", "", "it has no name");
    }
    if (!options.onePortPerLine) {
        FailToExpress("option", "onePortPerLine", "it cannot be cleared");
    }
    lines.Write(phrases.setNetlistName, {netlist.GetNameView()});
    const Port::StringBase<char> source = netlist.GetSourceFileName();
    if (!source.IsEmpty()) {
        lines.Write(phrases.setSourceFile, {source.GetView()});
    }
    OptionWriter writer(lines);
    writer.WriteHeaderTexts(options);
    writer.WriteVerilog(options.verilog);
    writer.WriteVhdl(options.vhdl);
}

} // namespace Orn_Hdl::Script
