#include "HdlCmd/Catalogue.h"

#include "Exception/Failure.h"
#include "HdlCmd/AttributeEntries.h"
#include "HdlCmd/CatalogueCommand.h"
#include "HdlCmd/Executing.h"
#include "HdlCmd/Parsing.h"
#include "Orn_Hdl/Model.h"
#include "Verilog/Dialects.h"

namespace Orn_Hdl {

namespace {

constexpr DialectSentence SynthesisHelp("Chooses the syntax of synthesis attributes in Verilog: ",
                                        ". VERILOG2001 writes no attributes.");

/// The command language. An entry holds the phrase, its arguments and its help, then how the line
/// is read and what is done.
constexpr CommandEntry Catalogue[] = {
    {{"NOOP", "", "Does nothing."}, ParseNothing, [](Model&, const Arguments&) {}},
    {{"SET NETLIST NAME", "<name>", "Names the module or entity."},
     ParseText<3>,
     Apply<&Model::SetName>},
    {{"SET SOURCE FILE", "<file>",
      "Records the file from which the design comes. It has no effect on the output."},
     ParseText<3>,
     Apply<&Model::SetSourceFileName>},
    {{"ADD COMPONENT", "<component>", "Adds a component (cell type)."},
     ParseText<2>,
     Apply<&Model::AddComponent>},
    {{"ADD PIN", "<component> <pin> <direction> [default]",
      "Adds a pin to a component. The direction is input, output or bidirectional, or the start "
      "of one. The default has no effect on the output."},
     ParsePin,
     ExecuteAddPin},
    {{"ADD INSTANCE", "<component> <instance>", "Adds an instance of a component."},
     ParseTexts<4, 3, 2>,
     Apply<&Model::AddInstance>},
    {{"ADD PORT", "<signal> <direction>", "Adds a port: a signal or bus with a direction."},
     ParsePort,
     ExecuteAddPort},
    {{"ADD SIGNAL", "<signal> [direction]",
      "Adds a signal or bus. A direction is checked but not used."},
     ParseSignal,
     Apply<&Model::AddSignal>},
    {{"CONNECT SIGNAL", "<signal> <signal|instance.pin>",
      "Connects a signal to a pin. With two signals, it writes assign first = second: the second "
      "drives the first."},
     ParseConnection,
     ExecuteConnection},
    {{"ASSIGN CONSTANT", "<signal|instance.pin> <value>",
      "Ties a signal or a pin to a constant: digits, or LENGTH:BASE:DIGITS with base B, O or H."},
     ParseConstant,
     ExecuteConstant},
    {{"WRITE VERILOG", "[-APPEND|-OVERWRITE] [-NOHEADER] <file>", "Writes the Verilog netlist."},
     ParseWrite,
     ExecuteWriteVerilog},
    {{"ADD INCLUDE", "<file>", "Adds a file that the Verilog netlist includes."},
     ParseText<2>,
     AppendOption<VerilogPart, &HdlOptions::VerilogOption::includePaths>},
    {{"SET SYNTHESIS", "<tool>", SynthesisHelp.GetText()}, ParseText<2>, ExecuteSetSynthesis},
    {{"UPPERCASE", "<instance|siganl|component>",
      "Writes names of that kind in upper case in Verilog; the word for signals is spelt "
      "siganl."},
     ParseUppercase,
     ExecuteCase<HdlOptions::VerilogOption::UPPERCASE>},
    {{"LOWERCASE", "<instance|signal|component>",
      "Writes names of that kind in lower case in Verilog."},
     ParseLowercase,
     ExecuteCase<HdlOptions::VerilogOption::LOWERCASE>},
    {{"WRITE VHDL", "[-APPEND|-OVERWRITE] [-NOHEADER] <file>", "Writes the VHDL netlist."},
     ParseWrite,
     ExecuteWriteVhdl},
    {{"FLATTEN BUS", "[true|false]",
      "Sets the flatten-bus flag; false clears it. It has no effect on the output."},
     ParseFlag<2>,
     SetFlag<VhdlPart, &HdlOptions::VhdlOption::flattenBus>},
    {{"SUPPRESS CONFIGURATION", "[true|false]",
      "Omits the configuration from VHDL; false writes it."},
     ParseFlag<2>,
     SetFlag<VhdlPart, &HdlOptions::VhdlOption::suppressConfiguration>},
    {{"SUPPRESS COMPONENT", "[true|false]",
      "Omits the component declarations from VHDL; false writes them."},
     ParseFlag<2>,
     SetFlag<VhdlPart, &HdlOptions::VhdlOption::suppressComponent>},
    {{"USE DEFAULT LIBRARY", "[true|false]",
      "Writes the library and use clauses for IEEE and KESTRA in VHDL; false omits them."},
     ParseFlag<3>,
     SetFlag<VhdlPart, &HdlOptions::VhdlOption::useDefaultLibrary>},
    {{"ADD LIBRARY", "<library>", "Adds a library clause to the VHDL netlist."},
     ParseText<2>,
     AppendOption<VhdlPart, &HdlOptions::VhdlOption::libraries>},
    {{"ADD USE LIBRARY", "<use clause>", "Adds a use clause to the VHDL netlist."},
     ParseText<3>,
     AppendOption<VhdlPart, &HdlOptions::VhdlOption::useClauses>},
    {{"ADD NOTES", "<text...>", "Adds a line to the module's comment."},
     ParseJoined<3, 2>,
     Apply<&Model::AddNotes>},
    {{"SET PORT ONEPERLINE", "",
      "Writes each port and each pin connection on a line of its own. That is the default and "
      "cannot be cleared, so it has no effect on the output."},
     ParseNothing,
     RaiseFlag<CommonPart, &HdlOptions::onePortPerLine>},
    {{"ADD MODULE COMMENT", "<text...>", "Adds a line to the module's comment."},
     ParseJoined<4, 3>,
     Apply<&Model::AddNotes>},
    {{"ADD COMPONENT COMMENT", "<component> <text...>",
      "Adds a line to the comment of a component."},
     ParseOwnerComment,
     Apply<&Model::AddComponentComment>},
    {{"ADD INSTANCE COMMENT", "<instance> <text...>", "Adds a line to the comment of an instance."},
     ParseOwnerComment,
     Apply<&Model::AddInstanceComment>},
    {{"ADD SIGNAL COMMENT", "<signal> <text...>", "Adds a line to the comment of a signal."},
     ParseOwnerComment,
     Apply<&Model::AddSignalComment>},
    {{"ADD COMPONENT PIN COMMENT", "<component.pin> <text...>",
      "Adds a line to the comment of a pin of a component. It has no effect on the output."},
     ParsePinComment,
     Apply<&Model::AddComponentPinComment>},
    {{"ADD INSTANCE PIN COMMENT", "<instance.pin> <text...>",
      "Adds a line to the comment of a pin of an instance. It has no effect on the output."},
     ParsePinComment,
     Apply<&Model::AddInstancePinComment>},
    AddAttribute<OfModule, &Model::AddModuleAttr>("ADD MODULE ATTRIBUTE"),
    AddAttribute<OfComponent, &Model::AddComponentAttr>("ADD COMPONENT ATTRIBUTE"),
    AddAttribute<OfInstance, &Model::AddInstanceAttr>("ADD INSTANCE ATTRIBUTE"),
    AddAttribute<OfSignal, &Model::AddSignalAttr>("ADD SIGNAL ATTRIBUTE"),
    AddAttribute<OfComponentPin, &Model::AddComponentPinAttr>("ADD COMPONENT PIN ATTRIBUTE"),
    AddAttribute<OfInstancePin, &Model::AddInstancePinAttr>("ADD INSTANCE PIN ATTRIBUTE"),
    SetAttributeValue<OfModule, &Model::SetModuleAttrValue>("SET MODULE ATTRIBUTE VALUE"),
    SetAttributeValue<OfComponent, &Model::SetComponentAttrValue>("SET COMPONENT ATTRIBUTE VALUE"),
    SetAttributeValue<OfInstance, &Model::SetInstanceAttrValue>("SET INSTANCE ATTRIBUTE VALUE"),
    SetAttributeValue<OfSignal, &Model::SetSignalAttrValue>("SET SIGNAL ATTRIBUTE VALUE"),
    SetAttributeValue<OfComponentPin, &Model::SetComponentPinAttrValue>(
        "SET COMPONENT PIN ATTRIBUTE VALUE"),
    SetAttributeValue<OfInstancePin, &Model::SetInstancePinAttrValue>(
        "SET INSTANCE PIN ATTRIBUTE VALUE"),
    SetAttributeUserType<OfModule, &Model::SetModuleUserType>("SET MODULE ATTRIBUTE USERTYPE"),
    SetAttributeUserType<OfComponent, &Model::SetComponentUserType>(
        "SET COMPONENT ATTRIBUTE USERTYPE"),
    SetAttributeUserType<OfInstance, &Model::SetInstanceUserType>(
        "SET INSTANCE ATTRIBUTE USERTYPE"),
    SetAttributeUserType<OfSignal, &Model::SetSignalUserType>("SET SIGNAL ATTRIBUTE USERTYPE"),
    SetAttributeUserType<OfComponentPin, &Model::SetComponentPinUserType>(
        "SET COMPONENT PIN ATTRIBUTE USERTYPE"),
    SetAttributeUserType<OfInstancePin, &Model::SetInstancePinUserType>(
        "SET INSTANCE PIN ATTRIBUTE USERTYPE"),
    SetAttributeOption<OfModule, &Model::SetModuleGenericAttrValue, &Model::SetModuleSynAttrValue>(
        "SET MODULE ATTRIBUTE OPTION"),
    SetAttributeOption<OfComponent, &Model::SetComponentGenericAttrValue,
                       &Model::SetComponentSynAttrValue>("SET COMPONENT ATTRIBUTE OPTION"),
    SetAttributeOption<OfInstance, &Model::SetInstanceGenericAttrValue,
                       &Model::SetInstanceSynAttrValue>("SET INSTANCE ATTRIBUTE OPTION"),
    SetAttributeOption<OfSignal, &Model::SetSignalGenericAttrValue, &Model::SetSignalSynAttrValue>(
        "SET SIGNAL ATTRIBUTE OPTION"),
    SetAttributeOption<OfComponentPin, &Model::SetComponentPinGenericAttrValue,
                       &Model::SetComponentPinSynAttrValue>("SET COMPONENT PIN ATTRIBUTE OPTION"),
    SetAttributeOption<OfInstancePin, &Model::SetInstancePinGenericAttrValue,
                       &Model::SetInstancePinSynAttrValue>("SET INSTANCE PIN ATTRIBUTE OPTION"),
    {{"Use AttrType", "", "Writes VHDL attributes with their own types instead of strings."},
     ParseNothing,
     RaiseFlag<VhdlPart, &HdlOptions::VhdlOption::useAttrType>},
    {{"Set Application", "<text>", "Names the application in the header."},
     ParseText<2>,
     SetText<&HdlOptions::application>},
    {{"Set Command", "<text...>", "Sets the command shown in the header."},
     ParseJoined<3, 2>,
     SetText<&HdlOptions::command>},
    {{"Set Device", "<text>", "Names the device in the header."},
     ParseText<2>,
     SetText<&HdlOptions::device>},
    {{"Set Purpose", "<text...>", "Sets the purpose shown in the header."},
     ParseJoined<3, 2>,
     SetText<&HdlOptions::purpose>},
    {{"Set Reference", "<text...>", "Sets the reference shown in the header."},
     ParseJoined<3, 2>,
     SetText<&HdlOptions::reference>},
    {{"Set Open Pin", "[true|false]",
      "Leaves unconnected input pins open in VHDL; false connects each to a signal of its own."},
     ParseFlag<3>,
     SetFlag<VhdlPart, &HdlOptions::VhdlOption::openPin>},
};

} // namespace

std::span<const RegisteredCommand> GetRegisteredCommands() noexcept {
    return RegisteredCommandsOf<Catalogue>;
}

std::string_view GetPhrase(CommandExecution execute) noexcept {
    for (const CommandEntry& entry : Catalogue) {
        if (entry.execute == execute) {
            return entry.info.phrase;
        }
    }
    return {};
}

Model& RequireModel(Model* model) {
    if (model == nullptr) {
        Fail(CommandUnit, __LINE__, "Missing Model.\n");
    }
    return *model;
}

} // namespace Orn_Hdl
