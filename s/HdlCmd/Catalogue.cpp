#include "HdlCmd/Catalogue.h"

#include "Exception/Failure.h"
#include "HdlCmd/Executing.h"
#include "HdlCmd/Parsing.h"
#include "Orn_Hdl/Model.h"
#include "Verilog/Dialects.h"

namespace Orn_Hdl {

namespace {

constexpr DialectSentence SynthesisHelp("Chooses the syntax of synthesis attributes in Verilog: ",
                                        ".");

constexpr CommandEntry NoOperationEntry{
    {"NOOP", "", "Does nothing."}, ParseNothing, [](Model&, const Arguments&) {}};
using NoOperationCommand = CatalogueCommand<NoOperationEntry>;

constexpr CommandEntry SetNetlistNameEntry{
    {"SET NETLIST NAME", "<name>", "Names the module or entity."},
    ParseText<3>,
    Apply<&Model::SetName>};
using SetNetlistNameCommand = CatalogueCommand<SetNetlistNameEntry>;

constexpr CommandEntry SetSourceFileEntry{
    {"SET SOURCE FILE", "<file>", "Remembers the file from which the design comes."},
    ParseText<3>,
    Apply<&Model::SetSourceFileName>};
using SetSourceFileCommand = CatalogueCommand<SetSourceFileEntry>;

constexpr CommandEntry AddComponentEntry{
    {"ADD COMPONENT", "<component>", "Adds a component (cell type)."},
    ParseText<2>,
    Apply<&Model::AddComponent>};
using AddComponentCommand = CatalogueCommand<AddComponentEntry>;

constexpr CommandEntry AddPinEntry{
    {"ADD PIN", "<component> <pin> <direction> [default]",
     "Adds a pin to a component; direction is input, output or bidirectional, or the start of "
     "one."},
    ParsePin,
    ExecuteAddPin};
using AddPinCommand = CatalogueCommand<AddPinEntry>;

constexpr CommandEntry AddInstanceEntry{
    {"ADD INSTANCE", "<component> <instance>", "Places a component."},
    ParseTexts<4, 3, 2>,
    Apply<&Model::AddInstance>};
using AddInstanceCommand = CatalogueCommand<AddInstanceEntry>;

constexpr CommandEntry AddPortEntry{
    {"ADD PORT", "<signal> <direction>", "Adds a signal or bus that is a port."},
    ParsePort,
    ExecuteAddPort};
using AddPortCommand = CatalogueCommand<AddPortEntry>;

constexpr CommandEntry AddSignalEntry{
    {"ADD SIGNAL", "<signal> [direction]",
     "Adds a signal or bus; a direction is checked and not used."},
    ParseSignal,
    Apply<&Model::AddSignal>};
using AddSignalCommand = CatalogueCommand<AddSignalEntry>;

constexpr CommandEntry ConnectSignalEntry{
    {"CONNECT SIGNAL", "<signal> <signal|instance.pin>",
     "Wires a signal to a pin, or makes the second signal an alias of the first."},
    ParseConnection,
    ExecuteConnection};
using ConnectSignalCommand = CatalogueCommand<ConnectSignalEntry>;

constexpr CommandEntry AssignConstantEntry{
    {"ASSIGN CONSTANT", "<signal|instance.pin> <value>",
     "Ties a signal or a pin to a constant: digits, or LENGTH:BASE:DIGITS with base B, O or H."},
    ParseConstant,
    ExecuteConstant};
using AssignConstantCommand = CatalogueCommand<AssignConstantEntry>;

constexpr CommandEntry WriteVerilogEntry{
    {"WRITE VERILOG", "[-APPEND|-OVERWRITE] [-NOHEADER] <file>", "Writes the Verilog netlist."},
    ParseWrite,
    ExecuteWriteVerilog};
using WriteVerilogCommand = CatalogueCommand<WriteVerilogEntry>;

constexpr CommandEntry AddIncludeEntry{
    {"ADD INCLUDE", "<file>", "Adds a file that the Verilog netlist includes."},
    ParseText<2>,
    AppendOption<VerilogPart, &HdlOptions::VerilogOption::includePaths>};
using AddIncludeCommand = CatalogueCommand<AddIncludeEntry>;

constexpr CommandEntry SetSynthesisEntry{
    {"SET SYNTHESIS", "<tool>", SynthesisHelp.GetText()}, ParseText<2>, ExecuteSetSynthesis};
using SetSynthesisCommand = CatalogueCommand<SetSynthesisEntry>;

constexpr CommandEntry UppercaseEntry{{"UPPERCASE", "<instance|siganl|component>",
                                       "Writes names of that kind in upper case in Verilog; the "
                                       "word for signals is spelt siganl."},
                                      ParseUppercase,
                                      ExecuteCase<HdlOptions::VerilogOption::UPPERCASE>};
using UppercaseCommand = CatalogueCommand<UppercaseEntry>;

constexpr CommandEntry LowercaseEntry{{"LOWERCASE", "<instance|signal|component>",
                                       "Writes names of that kind in lower case in Verilog."},
                                      ParseLowercase,
                                      ExecuteCase<HdlOptions::VerilogOption::LOWERCASE>};
using LowercaseCommand = CatalogueCommand<LowercaseEntry>;

constexpr CommandEntry WriteVhdlEntry{
    {"WRITE VHDL", "[-APPEND|-OVERWRITE] [-NOHEADER] <file>", "Writes the VHDL netlist."},
    ParseWrite,
    ExecuteWriteVhdl};
using WriteVhdlCommand = CatalogueCommand<WriteVhdlEntry>;

constexpr CommandEntry FlattenBusEntry{
    {"FLATTEN BUS", "[true|false]", "Sets the flatten-bus flag; false clears it."},
    ParseFlag<2>,
    SetFlag<VhdlPart, &HdlOptions::VhdlOption::flattenBus>};
using FlattenBusCommand = CatalogueCommand<FlattenBusEntry>;

constexpr CommandEntry SuppressConfigurationEntry{
    {"SUPPRESS CONFIGURATION", "[true|false]",
     "Leaves the configuration out of VHDL; false writes it."},
    ParseFlag<2>,
    SetFlag<VhdlPart, &HdlOptions::VhdlOption::suppressConfiguration>};
using SuppressConfigurationCommand = CatalogueCommand<SuppressConfigurationEntry>;

constexpr CommandEntry SuppressComponentEntry{
    {"SUPPRESS COMPONENT", "[true|false]",
     "Leaves the component declarations out of VHDL; false writes them."},
    ParseFlag<2>,
    SetFlag<VhdlPart, &HdlOptions::VhdlOption::suppressComponent>};
using SuppressComponentCommand = CatalogueCommand<SuppressComponentEntry>;

constexpr CommandEntry UseDefaultLibraryEntry{
    {"USE DEFAULT LIBRARY", "[true|false]",
     "Writes the IEEE and KESTRA clauses in VHDL; false leaves them out."},
    ParseFlag<3>,
    SetFlag<VhdlPart, &HdlOptions::VhdlOption::useDefaultLibrary>};
using UseDefaultLibraryCommand = CatalogueCommand<UseDefaultLibraryEntry>;

constexpr CommandEntry AddLibraryEntry{
    {"ADD LIBRARY", "<library>", "Adds a library clause to the VHDL netlist."},
    ParseText<2>,
    AppendOption<VhdlPart, &HdlOptions::VhdlOption::libraries>};
using AddLibraryCommand = CatalogueCommand<AddLibraryEntry>;

constexpr CommandEntry AddUseLibraryEntry{
    {"ADD USE LIBRARY", "<use clause>", "Adds a use clause to the VHDL netlist."},
    ParseText<3>,
    AppendOption<VhdlPart, &HdlOptions::VhdlOption::useClauses>};
using AddUseLibraryCommand = CatalogueCommand<AddUseLibraryEntry>;

constexpr CommandEntry AddNotesEntry{
    {"ADD NOTES", "<text...>", "Adds a line to the module's comment."},
    ParseJoined<3, 2>,
    Apply<&Model::AddNotes>};
using AddNotesCommand = CatalogueCommand<AddNotesEntry>;

constexpr CommandEntry SetPortOnePerLineEntry{
    {"SET PORT ONEPERLINE", "", "Writes each port and each pin connection on a line of its own."},
    ParseNothing,
    RaiseFlag<CommonPart, &HdlOptions::onePortPerLine>};
using SetPortOnePerLineCommand = CatalogueCommand<SetPortOnePerLineEntry>;

constexpr CommandEntry AddModuleCommentEntry{
    {"ADD MODULE COMMENT", "<text...>", "Adds a line to the module's comment."},
    ParseJoined<4, 3>,
    Apply<&Model::AddNotes>};
using AddModuleCommentCommand = CatalogueCommand<AddModuleCommentEntry>;

constexpr CommandEntry AddComponentCommentEntry{{"ADD COMPONENT COMMENT", "<component> <text...>",
                                                 "Adds a line to the comment of a component."},
                                                ParseOwnerComment,
                                                Apply<&Model::AddComponentComment>};
using AddComponentCommentCommand = CatalogueCommand<AddComponentCommentEntry>;

constexpr CommandEntry AddInstanceCommentEntry{
    {"ADD INSTANCE COMMENT", "<instance> <text...>", "Adds a line to the comment of an instance."},
    ParseOwnerComment,
    Apply<&Model::AddInstanceComment>};
using AddInstanceCommentCommand = CatalogueCommand<AddInstanceCommentEntry>;

constexpr CommandEntry AddSignalCommentEntry{
    {"ADD SIGNAL COMMENT", "<signal> <text...>", "Adds a line to the comment of a signal."},
    ParseOwnerComment,
    Apply<&Model::AddSignalComment>};
using AddSignalCommentCommand = CatalogueCommand<AddSignalCommentEntry>;

constexpr CommandEntry AddComponentPinCommentEntry{
    {"ADD COMPONENT PIN COMMENT", "<component.pin> <text...>",
     "Adds a line to the comment of a pin of a component."},
    ParsePinComment,
    Apply<&Model::AddComponentPinComment>};
using AddComponentPinCommentCommand = CatalogueCommand<AddComponentPinCommentEntry>;

constexpr CommandEntry AddInstancePinCommentEntry{
    {"ADD INSTANCE PIN COMMENT", "<instance.pin> <text...>",
     "Adds a line to the comment of a pin of an instance."},
    ParsePinComment,
    Apply<&Model::AddInstancePinComment>};
using AddInstancePinCommentCommand = CatalogueCommand<AddInstancePinCommentEntry>;

constexpr CommandEntry AddModuleAttrEntry{
    {"ADD MODULE ATTRIBUTE", "[-TYPE=<type>] <attribute> [value]",
     "Adds an attribute to the module, or sets its value; the type is String, Integer, Float, "
     "Boolean, Bit, BitVector or User."},
    ParseAddAttribute<OnModule>,
    Apply<&Model::AddModuleAttr>};
using AddModuleAttrCommand = CatalogueCommand<AddModuleAttrEntry>;

constexpr CommandEntry AddComponentAttrEntry{
    {"ADD COMPONENT ATTRIBUTE", "<component> [-TYPE=<type>] <attribute> [value]",
     "Adds an attribute to a component, or sets its value; the type is String, Integer, Float, "
     "Boolean, Bit, BitVector or User."},
    ParseAddAttribute<OnObject>,
    Apply<&Model::AddComponentAttr>};
using AddComponentAttrCommand = CatalogueCommand<AddComponentAttrEntry>;

constexpr CommandEntry AddInstanceAttrEntry{
    {"ADD INSTANCE ATTRIBUTE", "<instance> [-TYPE=<type>] <attribute> [value]",
     "Adds an attribute to an instance, or sets its value; the type is String, Integer, Float, "
     "Boolean, Bit, BitVector or User."},
    ParseAddAttribute<OnObject>,
    Apply<&Model::AddInstanceAttr>};
using AddInstanceAttrCommand = CatalogueCommand<AddInstanceAttrEntry>;

constexpr CommandEntry AddSignalAttrEntry{
    {"ADD SIGNAL ATTRIBUTE", "<signal> [-TYPE=<type>] <attribute> [value]",
     "Adds an attribute to a signal, or sets its value; the type is String, Integer, Float, "
     "Boolean, Bit, BitVector or User."},
    ParseAddAttribute<OnObject>,
    Apply<&Model::AddSignalAttr>};
using AddSignalAttrCommand = CatalogueCommand<AddSignalAttrEntry>;

constexpr CommandEntry AddComponentPinAttrEntry{
    {"ADD COMPONENT PIN ATTRIBUTE", "<component.pin> [-TYPE=<type>] <attribute> [value]",
     "Adds an attribute to a pin of a component, or sets its value; the type is String, "
     "Integer, Float, Boolean, Bit, BitVector or User."},
    ParseAddAttribute<OnPin>,
    Apply<&Model::AddComponentPinAttr>};
using AddComponentPinAttrCommand = CatalogueCommand<AddComponentPinAttrEntry>;

constexpr CommandEntry AddInstancePinAttrEntry{
    {"ADD INSTANCE PIN ATTRIBUTE", "<instance.pin> [-TYPE=<type>] <attribute> [value]",
     "Adds an attribute to a pin of an instance, or sets its value; the type is String, "
     "Integer, Float, Boolean, Bit, BitVector or User."},
    ParseAddAttribute<OnPin>,
    Apply<&Model::AddInstancePinAttr>};
using AddInstancePinAttrCommand = CatalogueCommand<AddInstancePinAttrEntry>;

constexpr CommandEntry SetModuleAttrValueEntry{{"SET MODULE ATTRIBUTE VALUE", "<attribute> <value>",
                                                "Sets the value of an attribute of the module."},
                                               ParseAttributeText<OnModule>,
                                               Apply<&Model::SetModuleAttrValue>};
using SetModuleAttrValueCommand = CatalogueCommand<SetModuleAttrValueEntry>;

constexpr CommandEntry SetComponentAttrValueEntry{
    {"SET COMPONENT ATTRIBUTE VALUE", "<component> <attribute> <value>",
     "Sets the value of an attribute of a component."},
    ParseAttributeText<OnObject>,
    Apply<&Model::SetComponentAttrValue>};
using SetComponentAttrValueCommand = CatalogueCommand<SetComponentAttrValueEntry>;

constexpr CommandEntry SetInstanceAttrValueEntry{{"SET INSTANCE ATTRIBUTE VALUE",
                                                  "<instance> <attribute> <value>",
                                                  "Sets the value of an attribute of an instance."},
                                                 ParseAttributeText<OnObject>,
                                                 Apply<&Model::SetInstanceAttrValue>};
using SetInstanceAttrValueCommand = CatalogueCommand<SetInstanceAttrValueEntry>;

constexpr CommandEntry SetSignalAttrValueEntry{{"SET SIGNAL ATTRIBUTE VALUE",
                                                "<signal> <attribute> <value>",
                                                "Sets the value of an attribute of a signal."},
                                               ParseAttributeText<OnObject>,
                                               Apply<&Model::SetSignalAttrValue>};
using SetSignalAttrValueCommand = CatalogueCommand<SetSignalAttrValueEntry>;

constexpr CommandEntry SetComponentPinAttrValueEntry{
    {"SET COMPONENT PIN ATTRIBUTE VALUE", "<component.pin> <attribute> <value>",
     "Sets the value of an attribute of a pin of a component."},
    ParseAttributeText<OnPin>,
    Apply<&Model::SetComponentPinAttrValue>};
using SetComponentPinAttrValueCommand = CatalogueCommand<SetComponentPinAttrValueEntry>;

constexpr CommandEntry SetInstancePinAttrValueEntry{
    {"SET INSTANCE PIN ATTRIBUTE VALUE", "<instance.pin> <attribute> <value>",
     "Sets the value of an attribute of a pin of an instance."},
    ParseAttributeText<OnPin>,
    Apply<&Model::SetInstancePinAttrValue>};
using SetInstancePinAttrValueCommand = CatalogueCommand<SetInstancePinAttrValueEntry>;

constexpr CommandEntry SetModuleAttrUserTypeEntry{
    {"SET MODULE ATTRIBUTE USERTYPE", "<attribute> <type>",
     "Names the type of an attribute of type User of the module."},
    ParseAttributeText<OnModule>,
    Apply<&Model::SetModuleUserType>};
using SetModuleAttrUserTypeCommand = CatalogueCommand<SetModuleAttrUserTypeEntry>;

constexpr CommandEntry SetComponentAttrUserTypeEntry{
    {"SET COMPONENT ATTRIBUTE USERTYPE", "<component> <attribute> <type>",
     "Names the type of an attribute of type User of a component."},
    ParseAttributeText<OnObject>,
    Apply<&Model::SetComponentUserType>};
using SetComponentAttrUserTypeCommand = CatalogueCommand<SetComponentAttrUserTypeEntry>;

constexpr CommandEntry SetInstanceAttrUserTypeEntry{
    {"SET INSTANCE ATTRIBUTE USERTYPE", "<instance> <attribute> <type>",
     "Names the type of an attribute of type User of an instance."},
    ParseAttributeText<OnObject>,
    Apply<&Model::SetInstanceUserType>};
using SetInstanceAttrUserTypeCommand = CatalogueCommand<SetInstanceAttrUserTypeEntry>;

constexpr CommandEntry SetSignalAttrUserTypeEntry{
    {"SET SIGNAL ATTRIBUTE USERTYPE", "<signal> <attribute> <type>",
     "Names the type of an attribute of type User of a signal."},
    ParseAttributeText<OnObject>,
    Apply<&Model::SetSignalUserType>};
using SetSignalAttrUserTypeCommand = CatalogueCommand<SetSignalAttrUserTypeEntry>;

constexpr CommandEntry SetComponentPinAttrUserTypeEntry{
    {"SET COMPONENT PIN ATTRIBUTE USERTYPE", "<component.pin> <attribute> <type>",
     "Names the type of an attribute of type User of a pin of a component."},
    ParseAttributeText<OnPin>,
    Apply<&Model::SetComponentPinUserType>};
using SetComponentPinAttrUserTypeCommand = CatalogueCommand<SetComponentPinAttrUserTypeEntry>;

constexpr CommandEntry SetInstancePinAttrUserTypeEntry{
    {"SET INSTANCE PIN ATTRIBUTE USERTYPE", "<instance.pin> <attribute> <type>",
     "Names the type of an attribute of type User of a pin of an instance."},
    ParseAttributeText<OnPin>,
    Apply<&Model::SetInstancePinUserType>};
using SetInstancePinAttrUserTypeCommand = CatalogueCommand<SetInstancePinAttrUserTypeEntry>;

constexpr CommandEntry SetModuleAttrOptionEntry{
    {"SET MODULE ATTRIBUTE OPTION", "<attribute> <option> [option]",
     "Sets how an attribute of the module is written: -GENERIC=NONE|SYN|NOSYN, "
     "-SYNATTR=NONE|ASSIGN|ASSIGNNODEC."},
    ParseAttributeOptions<OnModule>,
    ApplyOptions<&Model::SetModuleGenericAttrValue, &Model::SetModuleSynAttrValue>};
using SetModuleAttrOptionCommand = CatalogueCommand<SetModuleAttrOptionEntry>;

constexpr CommandEntry SetComponentAttrOptionEntry{
    {"SET COMPONENT ATTRIBUTE OPTION", "<component> <attribute> <option> [option]",
     "Sets how an attribute of a component is written: -GENERIC=NONE|SYN|NOSYN, "
     "-SYNATTR=NONE|ASSIGN|ASSIGNNODEC."},
    ParseAttributeOptions<OnObject>,
    ApplyOptions<&Model::SetComponentGenericAttrValue, &Model::SetComponentSynAttrValue>};
using SetComponentAttrOptionCommand = CatalogueCommand<SetComponentAttrOptionEntry>;

constexpr CommandEntry SetInstanceAttrOptionEntry{
    {"SET INSTANCE ATTRIBUTE OPTION", "<instance> <attribute> <option> [option]",
     "Sets how an attribute of an instance is written: -GENERIC=NONE|SYN|NOSYN, "
     "-SYNATTR=NONE|ASSIGN|ASSIGNNODEC."},
    ParseAttributeOptions<OnObject>,
    ApplyOptions<&Model::SetInstanceGenericAttrValue, &Model::SetInstanceSynAttrValue>};
using SetInstanceAttrOptionCommand = CatalogueCommand<SetInstanceAttrOptionEntry>;

constexpr CommandEntry SetSignalAttrOptionEntry{
    {"SET SIGNAL ATTRIBUTE OPTION", "<signal> <attribute> <option> [option]",
     "Sets how an attribute of a signal is written: -GENERIC=NONE|SYN|NOSYN, "
     "-SYNATTR=NONE|ASSIGN|ASSIGNNODEC."},
    ParseAttributeOptions<OnObject>,
    ApplyOptions<&Model::SetSignalGenericAttrValue, &Model::SetSignalSynAttrValue>};
using SetSignalAttrOptionCommand = CatalogueCommand<SetSignalAttrOptionEntry>;

constexpr CommandEntry SetComponentPinAttrOptionEntry{
    {"SET COMPONENT PIN ATTRIBUTE OPTION", "<component.pin> <attribute> <option> [option]",
     "Sets how an attribute of a pin of a component is written: -GENERIC=NONE|SYN|NOSYN, "
     "-SYNATTR=NONE|ASSIGN|ASSIGNNODEC."},
    ParseAttributeOptions<OnPin>,
    ApplyOptions<&Model::SetComponentPinGenericAttrValue, &Model::SetComponentPinSynAttrValue>};
using SetComponentPinAttrOptionCommand = CatalogueCommand<SetComponentPinAttrOptionEntry>;

constexpr CommandEntry SetInstancePinAttrOptionEntry{
    {"SET INSTANCE PIN ATTRIBUTE OPTION", "<instance.pin> <attribute> <option> [option]",
     "Sets how an attribute of a pin of an instance is written: -GENERIC=NONE|SYN|NOSYN, "
     "-SYNATTR=NONE|ASSIGN|ASSIGNNODEC."},
    ParseAttributeOptions<OnPin>,
    ApplyOptions<&Model::SetInstancePinGenericAttrValue, &Model::SetInstancePinSynAttrValue>};
using SetInstancePinAttrOptionCommand = CatalogueCommand<SetInstancePinAttrOptionEntry>;

constexpr CommandEntry UseAttrTypeEntry{
    {"Use AttrType", "", "Writes VHDL attributes with their own types in place of strings."},
    ParseNothing,
    RaiseFlag<VhdlPart, &HdlOptions::VhdlOption::useAttrType>};
using UseAttrTypeCommand = CatalogueCommand<UseAttrTypeEntry>;

constexpr CommandEntry SetApplicationEntry{
    {"Set Application", "<text>", "Names the application in the header."},
    ParseText<2>,
    SetText<&HdlOptions::application>};
using SetApplicationCommand = CatalogueCommand<SetApplicationEntry>;

constexpr CommandEntry SetCommandStrEntry{
    {"Set Command", "<text...>", "Sets the command shown in the header."},
    ParseJoined<3, 2>,
    SetText<&HdlOptions::command>};
using SetCommandStrCommand = CatalogueCommand<SetCommandStrEntry>;

constexpr CommandEntry SetDeviceEntry{{"Set Device", "<text>", "Names the device in the header."},
                                      ParseText<2>,
                                      SetText<&HdlOptions::device>};
using SetDeviceCommand = CatalogueCommand<SetDeviceEntry>;

constexpr CommandEntry SetPurposeEntry{
    {"Set Purpose", "<text...>", "Sets the purpose shown in the header."},
    ParseJoined<3, 2>,
    SetText<&HdlOptions::purpose>};
using SetPurposeCommand = CatalogueCommand<SetPurposeEntry>;

constexpr CommandEntry SetReferenceEntry{
    {"Set Reference", "<text...>", "Sets the reference shown in the header."},
    ParseJoined<3, 2>,
    SetText<&HdlOptions::reference>};
using SetReferenceCommand = CatalogueCommand<SetReferenceEntry>;

constexpr CommandEntry SetOpenPinEntry{
    {"Set Open Pin", "[true|false]",
     "Leaves unconnected input pins open in VHDL; false ties them to signals of their own."},
    ParseFlag<3>,
    SetFlag<VhdlPart, &HdlOptions::VhdlOption::openPin>};
using SetOpenPinCommand = CatalogueCommand<SetOpenPinEntry>;

} // namespace

const std::vector<RegisteredCommand>& GetRegisteredCommands() {
    static const std::vector<RegisteredCommand> commands{
        {&NoOperationEntry, &NoOperationCommand::Create},
        {&SetNetlistNameEntry, &SetNetlistNameCommand::Create},
        {&SetSourceFileEntry, &SetSourceFileCommand::Create},
        {&AddComponentEntry, &AddComponentCommand::Create},
        {&AddPinEntry, &AddPinCommand::Create},
        {&AddInstanceEntry, &AddInstanceCommand::Create},
        {&AddPortEntry, &AddPortCommand::Create},
        {&AddSignalEntry, &AddSignalCommand::Create},
        {&ConnectSignalEntry, &ConnectSignalCommand::Create},
        {&AssignConstantEntry, &AssignConstantCommand::Create},
        {&WriteVerilogEntry, &WriteVerilogCommand::Create},
        {&AddIncludeEntry, &AddIncludeCommand::Create},
        {&SetSynthesisEntry, &SetSynthesisCommand::Create},
        {&UppercaseEntry, &UppercaseCommand::Create},
        {&LowercaseEntry, &LowercaseCommand::Create},
        {&WriteVhdlEntry, &WriteVhdlCommand::Create},
        {&FlattenBusEntry, &FlattenBusCommand::Create},
        {&SuppressConfigurationEntry, &SuppressConfigurationCommand::Create},
        {&SuppressComponentEntry, &SuppressComponentCommand::Create},
        {&UseDefaultLibraryEntry, &UseDefaultLibraryCommand::Create},
        {&AddLibraryEntry, &AddLibraryCommand::Create},
        {&AddUseLibraryEntry, &AddUseLibraryCommand::Create},
        {&AddNotesEntry, &AddNotesCommand::Create},
        {&SetPortOnePerLineEntry, &SetPortOnePerLineCommand::Create},
        {&AddModuleCommentEntry, &AddModuleCommentCommand::Create},
        {&AddComponentCommentEntry, &AddComponentCommentCommand::Create},
        {&AddInstanceCommentEntry, &AddInstanceCommentCommand::Create},
        {&AddSignalCommentEntry, &AddSignalCommentCommand::Create},
        {&AddComponentPinCommentEntry, &AddComponentPinCommentCommand::Create},
        {&AddInstancePinCommentEntry, &AddInstancePinCommentCommand::Create},
        {&AddModuleAttrEntry, &AddModuleAttrCommand::Create},
        {&AddComponentAttrEntry, &AddComponentAttrCommand::Create},
        {&AddInstanceAttrEntry, &AddInstanceAttrCommand::Create},
        {&AddSignalAttrEntry, &AddSignalAttrCommand::Create},
        {&AddComponentPinAttrEntry, &AddComponentPinAttrCommand::Create},
        {&AddInstancePinAttrEntry, &AddInstancePinAttrCommand::Create},
        {&SetModuleAttrValueEntry, &SetModuleAttrValueCommand::Create},
        {&SetComponentAttrValueEntry, &SetComponentAttrValueCommand::Create},
        {&SetInstanceAttrValueEntry, &SetInstanceAttrValueCommand::Create},
        {&SetSignalAttrValueEntry, &SetSignalAttrValueCommand::Create},
        {&SetComponentPinAttrValueEntry, &SetComponentPinAttrValueCommand::Create},
        {&SetInstancePinAttrValueEntry, &SetInstancePinAttrValueCommand::Create},
        {&SetModuleAttrUserTypeEntry, &SetModuleAttrUserTypeCommand::Create},
        {&SetComponentAttrUserTypeEntry, &SetComponentAttrUserTypeCommand::Create},
        {&SetInstanceAttrUserTypeEntry, &SetInstanceAttrUserTypeCommand::Create},
        {&SetSignalAttrUserTypeEntry, &SetSignalAttrUserTypeCommand::Create},
        {&SetComponentPinAttrUserTypeEntry, &SetComponentPinAttrUserTypeCommand::Create},
        {&SetInstancePinAttrUserTypeEntry, &SetInstancePinAttrUserTypeCommand::Create},
        {&SetModuleAttrOptionEntry, &SetModuleAttrOptionCommand::Create},
        {&SetComponentAttrOptionEntry, &SetComponentAttrOptionCommand::Create},
        {&SetInstanceAttrOptionEntry, &SetInstanceAttrOptionCommand::Create},
        {&SetSignalAttrOptionEntry, &SetSignalAttrOptionCommand::Create},
        {&SetComponentPinAttrOptionEntry, &SetComponentPinAttrOptionCommand::Create},
        {&SetInstancePinAttrOptionEntry, &SetInstancePinAttrOptionCommand::Create},
        {&UseAttrTypeEntry, &UseAttrTypeCommand::Create},
        {&SetApplicationEntry, &SetApplicationCommand::Create},
        {&SetCommandStrEntry, &SetCommandStrCommand::Create},
        {&SetDeviceEntry, &SetDeviceCommand::Create},
        {&SetPurposeEntry, &SetPurposeCommand::Create},
        {&SetReferenceEntry, &SetReferenceCommand::Create},
        {&SetOpenPinEntry, &SetOpenPinCommand::Create}};
    return commands;
}

Model& RequireModel(Model* model) {
    if (model == nullptr) {
        Fail(CommandUnit, __LINE__, "Missing Model.\n");
    }
    return *model;
}

} // namespace Orn_Hdl
