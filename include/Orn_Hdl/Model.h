/// \file
/// `Model`, one design and every operation on it by name, and with it every header of the design.
#pragma once

#include "Orn_Hdl/Attributes.h"
#include "Orn_Hdl/Containers/StringArray.h"
#include "Orn_Hdl/Model/Component.h"
#include "Orn_Hdl/Model/ConstVisitors.h"
#include "Orn_Hdl/Model/Netlist.h"
#include "Orn_Hdl/Model/Object.h"
#include "Orn_Hdl/Model/Pins.h"
#include "Orn_Hdl/Model/Signals.h"
#include "Orn_Hdl/Options.h"
#include "Port/Export.h"
#include "Port/String.h"
#include "Port/TextArgument.h"
#include "Port/TextView.h"

#include <cstddef>
#include <cstdint>
#include <memory>
#include <string_view>

namespace Port {
class Folder;
}

namespace Orn_Hdl {

class CommandFactory;
class CommandManager;
class Engine;
class OutStream;

/// Decides which files the write commands of a model may write, for programs that run command files
/// they do not trust.
class ORN_HDL_API OutputGuard {
public:
    OutputGuard() = default;
    OutputGuard(const OutputGuard&) = delete;
    OutputGuard& operator=(const OutputGuard&) = delete;
    virtual ~OutputGuard();
    /// Asked before a file is opened. It may destroy the model that asks; nothing is written then.
    /// \param fileName the file, as the command names it; never null.
    /// \return an empty text when the file may be written, otherwise why it may not.
    virtual Port::StringBase<char> WhyNot(const char* fileName) = 0;
    /// Asked after `WhyNot` has allowed a file: below which folder the file is opened. Unless this
    /// is overridden, that is wherever the file's name leads at that moment.
    /// \param path receives the file's path below the folder, free of links and "..": no link is
    ///        followed (`Port::File::OpenBelow`).
    /// \return the folder, not owned, which must stay open during the call; or null.
    virtual const Port::Folder* GetFolder(const char* fileName, Port::StringBase<char>& path);
};

/// One design: its netlist, its output options and its done commands.
///
/// Every operation takes texts of any kind (`Port::TextArgument`), looks the named objects up,
/// checks them, and throws `Orn_Hdl::Exception` with a fixed message when a check fails; nothing
/// that was done before is undone. A null name reads as "" in every look-up. Operations that change
/// the design set the modified flag, but for `SetName` and `SetSourceFileName`. Where an operation
/// returns a `bool` and nothing else is said, that is always true: what fails throws.
///
/// Signals need not be declared: the first use of a name in a connection or constant declares it,
/// and its form tells what it is: N a scalar signal, D(7:0) a bus or a slice of the bus D, D(2) a
/// bit of the bus D, A,D(3:0) a compound. Brackets "[]", "{}", "<>" and "()" are one and the same.
class ORN_HDL_API Model {
public:
    /// A piece of work on a model; defined and used by the library alone.
    class Use;

    /// \param factory makes the commands; not owned, must outlive the model. Null: no command is
    ///        ever found.
    explicit Model(CommandFactory* factory);
    Model(const Model&) = delete;
    Model& operator=(const Model&) = delete;
    /// Deletes the done commands, the first one first, then the design. A command of the model may
    /// destroy it: the command is then deleted when it is through, and no further line of a command
    /// file is read.
    ~Model();

    /// Whether the design has changed since the flag was cleared.
    bool IsModified() const noexcept;
    /// Sets or clears the modified flag.
    void SetModifiedFlag(bool modified) noexcept;

    /// The netlist, owned by the model; never null.
    Netlist* GetNetlist() noexcept;
    /// The netlist of a model that is not to be changed, owned by the model; never null.
    const Netlist* GetNetlist() const noexcept;
    /// The output options, owned by the model; never null.
    HdlOptions* GetOptions() noexcept;
    /// The factory that the constructor was given, which the model does not own; null without one.
    CommandFactory* GetCommandFactory() const noexcept;
    /// The done commands, owned by the model; never null.
    CommandManager* GetCommandManager() noexcept;

    /// The netlist's name, which is the model's.
    Port::StringBase<char> GetName() const;
    /// Renames the netlist; null gives "HDL_NETLIST".
    void SetName(const Port::TextArgument& name);
    /// The file from which the design comes; empty when it is not known.
    Port::StringBase<char> GetSourceFileName() const;
    /// Remembers from which file the design comes; null is read as "".
    void SetSourceFileName(const Port::TextArgument& name);

    /// Splits a command line and executes it. An empty line, and null, do nothing.
    /// \return true whenever no exception is thrown.
    bool Execute(Port::TextView text) { return ExecuteLine(text); }
    /// Splits a line of known length, which ends at its first NUL, and executes it.
    /// \return true whenever no exception is thrown.
    bool ExecuteLine(std::string_view line);
    /// Executes a line that has been split into words.
    /// \return true whenever no exception is thrown.
    bool Execute(const StringArray& tokens);
    /// Executes the lines of a command file and clears the modified flag. When a line throws, the
    /// lines before it stay done.
    /// \return false when the file cannot be opened or read; otherwise true, since no line fails
    ///         without an exception.
    bool Read(const Port::TextArgument& fileName);
    /// Writes the commands from which the design and its options come, one a line. The lines depend
    /// on the state of the model alone, not on how it came to it. A fresh model that executes them
    /// writes the same Verilog and VHDL as this one, and these lines again.
    ///
    /// No command makes the dummy signals of a write, so these are declared as signals like any
    /// others, and have in the lines what the next write would hand over to them. Where a compound
    /// has them as members, or a bus has new slices or bits since, the netlists of both models have
    /// the same assignments, but may have them in another order.
    ///
    /// Options that no command sets, such as `HdlOptions::legal`, are not in the lines.
    /// \param out must be at indent level 0.
    /// \throws Exception "No command can express ...\n" for what only calls can make, such as an
    ///         instance without a component, and for names that the lines of commands cannot have,
    ///         such as one with a line feed. Nothing is written then.
    void WriteCommands(OutStream& out) const;
    /// Writes the commands to a file, which takes the place of an existing one when it is complete.
    /// \return false when the file cannot be written.
    /// \throws Exception as the overload for a stream does; the file is not touched then.
    bool WriteCommands(const Port::TextArgument& fileName) const;
    /// Clears the modified flag and returns true; done commands are kept in memory only.
    bool Write(const Port::TextArgument& fileName);

    /// Sets who is asked before a write command opens its file. What it refuses fails the command,
    /// which then changes nothing.
    /// \param guard not owned; null, as at first, when every file may be written.
    void SetOutputGuard(OutputGuard* guard) noexcept;
    /// Who is asked before a write command opens its file; null for nobody.
    OutputGuard* GetOutputGuard() const noexcept;
    /// Remembers what became of the last netlist that a write command wrote.
    /// \param error the system's error number; 0 when every byte was written.
    /// \param leftover how many bytes stand at the end of a file although appending has failed.
    void RecordWrite(const Port::TextArgument& fileName, int error, std::uint64_t leftover = 0);
    /// The error number of the last write; 0 when it succeeded, and before the first.
    int GetWriteError() const noexcept;
    /// How many bytes of the last write stand at the end of the file although appending has failed.
    std::uint64_t GetWriteLeftover() const noexcept;
    /// The file name of the last write; empty before the first.
    Port::StringBase<char> GetWrittenFileName() const;

    /// The component of that name, owned by the netlist; null when there is none.
    Component* GetComponent(const Port::TextArgument& name) const;
    /// The instance of that name, owned by the netlist; null when there is none.
    Instance* GetInstance(const Port::TextArgument& name) const;
    /// The signal of that name, owned by the netlist; null when there is none.
    Signal* GetSignal(const Port::TextArgument& name) const;
    /// The pin of that name, owned by the component; null when there is none, or no component.
    Pin* GetPin(const Port::TextArgument& name, const Component* component) const;
    /// The pin of that name, owned by the instance; null when there is none, or no instance.
    Pin* GetPin(const Port::TextArgument& name, const Instance* instance) const;
    /// Null, since there is no owner to look in.
    Pin* GetPin(const Port::TextArgument& /*name*/, std::nullptr_t) const noexcept {
        return nullptr;
    }
    /// The attribute of that name, owned by the holder; null when there is none, or no holder.
    Attribute* GetAttr(const Port::TextArgument& name, const AttributeHolder* holder) const;

    /// Declares a component without pins. Components, instances and signals share one name space.
    /// \return true.
    /// \throws Exception "Identifier ... already defined.\n" when the name is taken.
    bool AddComponent(const Port::TextArgument& name);
    /// Appends a pin to a component; a default value that is not empty is taken. Instances that are
    /// there already do not get it.
    /// \param polarity not checked: a pin of an invalid one is written as an output in VHDL. The
    ///        overload that takes a text refuses what is no direction.
    /// \return true.
    /// \throws Exception "Component ... not found.\n", "Component ... already has pin ...\n".
    bool AddPin(const Port::TextArgument& name, const Polarity& polarity,
                const Port::TextArgument& component, const Port::TextArgument& defaultValue);
    /// Appends a pin to a component, as the overload with a `Polarity` does.
    /// \param direction as `Polarity::Parse` reads it: "inout" is bidirectional.
    /// \return true.
    /// \throws Exception "Invalid direction ...\n", "Component ... not found.\n", "Component ...
    ///         already has pin ...\n".
    bool AddPin(const Port::TextArgument& name, const Port::TextArgument& direction,
                const Port::TextArgument& component,
                const Port::TextArgument& defaultValue = nullptr);
    /// Places a component: the instance gets its own copies of the component's pins, all open.
    /// \return true.
    /// \throws Exception "Identifier ... already defined.\n", "Component ... not found.\n".
    bool AddInstance(const Port::TextArgument& name, const Port::TextArgument& component);
    /// Declares a signal, or a bus when the name has a range. It is no port until it is given a
    /// polarity.
    /// \return true.
    /// \throws Exception "Identifier ... already defined.\n", or, for a bus whose base name another
    ///         bus has, "Signal ... already declared.\n".
    bool AddSignal(const Port::TextArgument& name);
    /// Declares a port: a signal, or a bus when the name has a range, with a direction.
    /// \return true.
    /// \throws Exception "Invalid direction ...\n" if the polarity is not valid; what `AddSignal`
    ///         throws.
    bool AddPort(const Port::TextArgument& name, const Polarity& polarity);
    /// Declares a port: a signal, or a bus when the name has a range, with a direction.
    /// \param direction as `Polarity::Parse` reads it: "inout" is bidirectional.
    /// \return true.
    /// \throws Exception "Invalid direction ...\n"; what `AddSignal` throws.
    bool AddPort(const Port::TextArgument& name, const Port::TextArgument& direction);
    /// The net of one bit of a bus, owned by the netlist, made on its first use. Unlike a name such
    /// as "D(3)" in a connection, the index has to be in the range of the bus.
    /// \param bus the bus, with or without its range.
    /// \return never null.
    /// \throws Exception "Signal ... not found.\n" if there is no such bus, if the index is out of
    ///         its range, and if another kind of signal has the name of the bit.
    BusIndex* Bit(const Port::TextArgument& bus, int index);
    /// Renames a component, which is found by the new name from then on. The new name
    /// may differ from the old one in letter case alone.
    /// \return true.
    /// \throws Exception "Invalid Name.\n" for a null new name, "Component ... not found.\n",
    ///         "Identifier ... already defined.\n".
    bool RenameComponent(const Port::TextArgument& name, const Port::TextArgument& newName);
    /// Renames an instance, which is found by the new name from then on. The new name
    /// may differ from the old one in letter case alone.
    /// \return true.
    /// \throws Exception "Invalid Name.\n" for a null new name, "... not found.\n", "Identifier ...
    ///         already defined.\n".
    bool RenameInstance(const Port::TextArgument& name, const Port::TextArgument& newName);
    /// Renames a scalar signal or a bus, which is found by the new name from then on. The slices
    /// and bits of a bus are renamed with it, and so is every compound whose name names one of
    /// these. A bus keeps its range, and the new name has to have it too. The new name
    /// may differ from the old one in letter case alone. If allocation fails, either everything or
    /// nothing is renamed.
    /// \return true.
    /// \throws Exception "Invalid Name.\n" for a null new name, a new name of another form or
    ///         range, and a slice, bit or compound; "Signal ... not found.\n"; "Identifier ...
    ///         already defined.\n" for any of the new names; for a bus whose new base name another
    ///         bus has, "Signal ... already declared.\n".
    bool RenameSignal(const Port::TextArgument& name, const Port::TextArgument& newName);
    /// Connects a pin to a signal, which is declared on its first use.
    /// \return true.
    /// \throws Exception "Signal ... not found.\n" for an instance that is not there, and for a bit
    ///         of a bus that is not there; "Pin ... not found.\n".
    bool ConnectSignalToPin(const Port::TextArgument& signal, const Port::TextArgument& instance,
                            const Port::TextArgument& pin);
    /// Makes the second signal an alias of the first; both are declared on their first use.
    /// \return true.
    /// \throws Exception "Signal ... not found.\n" for a bit of a bus that is not there.
    bool ConnectSignals(const Port::TextArgument& first, const Port::TextArgument& second);
    /// Ties a signal to a constant; the signal is declared on its first use.
    /// \param value digits, or LENGTH:BASE:DIGITS as `BitVectorValue` reads it; not checked.
    /// \return true.
    /// \throws Exception "Signal ... not found.\n" for a bit of a bus that is not there.
    bool AssignConstantToSignal(const Port::TextArgument& signal, const Port::TextArgument& value);
    /// Connects a pin to a signal of its own that carries the constant.
    /// \param value digits, or LENGTH:BASE:DIGITS as `BitVectorValue` reads it; not checked.
    /// \return true.
    /// \throws Exception "Signal ... not found.\n" for an instance that is not there, "Pin ... not
    ///         found.\n".
    bool AssignConstantToPin(const Port::TextArgument& instance, const Port::TextArgument& pin,
                             const Port::TextArgument& value);

    /// Adds an attribute to a holder, which owns it, or gives one that is present another value,
    /// its type kept.
    /// \param type one of the seven type names; null means "String".
    /// \return false for a null holder, else true.
    /// \throws Exception "Invalid attribute type.\n".
    bool AddAttr(AttributeHolder* holder, const Port::TextArgument& name,
                 const Port::TextArgument& value, const Port::TextArgument& type);
    /// Adds an attribute to a holder, or gives one that is present another value, and sets both of
    /// its options.
    /// \param type one of the seven type names; null means "String". It does not count for an
    ///        attribute that is present.
    /// \return false for a null holder, else true.
    /// \throws Exception "Invalid attribute type.\n".
    bool AddAttr(AttributeHolder* holder, const Port::TextArgument& name,
                 const Port::TextArgument& value, const Port::TextArgument& type,
                 Attribute::GenericOption generic,
                 Attribute::SynAttrOption synAttr = Attribute::SynAttrNone);
    /// Adds an attribute to a holder, or gives one that is present another value, and sets its
    /// synthesis option; its generic option becomes `GenericNone`.
    /// \param type one of the seven type names; null means "String". It does not count for an
    ///        attribute that is present.
    /// \return false for a null holder, else true.
    /// \throws Exception "Invalid attribute type.\n".
    bool AddAttr(AttributeHolder* holder, const Port::TextArgument& name,
                 const Port::TextArgument& value, const Port::TextArgument& type,
                 Attribute::SynAttrOption synAttr) {
        return AddAttr(holder, name, value, type, Attribute::GenericNone, synAttr);
    }
    /// Adds an attribute to the module, as `AddAttr` does.
    /// \return true.
    /// \throws Exception "Invalid Name.\n" for a null name, "Invalid attribute type.\n".
    bool AddModuleAttr(const Port::TextArgument& name, const Port::TextArgument& value,
                       const Port::TextArgument& type);
    /// Adds an attribute to a component, as `AddAttr` does.
    /// \return true.
    /// \throws Exception "... not found.\n", "Invalid Name.\n" for a null name, "Invalid attribute
    ///         type.\n".
    bool AddComponentAttr(const Port::TextArgument& component, const Port::TextArgument& name,
                          const Port::TextArgument& value, const Port::TextArgument& type);
    /// Adds an attribute to an instance, as `AddAttr` does.
    /// \return true.
    /// \throws Exception "... not found.\n", "Invalid Name.\n" for a null name, "Invalid attribute
    ///         type.\n".
    bool AddInstanceAttr(const Port::TextArgument& instance, const Port::TextArgument& name,
                         const Port::TextArgument& value, const Port::TextArgument& type);
    /// Adds an attribute to a signal, as `AddAttr` does.
    /// \return true.
    /// \throws Exception "... not found.\n", "Invalid Name.\n" for a null name, "Invalid attribute
    ///         type.\n".
    bool AddSignalAttr(const Port::TextArgument& signal, const Port::TextArgument& name,
                       const Port::TextArgument& value, const Port::TextArgument& type);
    /// Adds an attribute to a pin of a component, as `AddAttr` does.
    /// \return true.
    /// \throws Exception "Pin ... not found.\n", "Invalid Name.\n" for a null name, "Invalid
    ///         attribute type.\n".
    bool AddComponentPinAttr(const Port::TextArgument& component, const Port::TextArgument& pin,
                             const Port::TextArgument& name, const Port::TextArgument& value,
                             const Port::TextArgument& type);
    /// Adds an attribute to a pin of an instance, as `AddAttr` does.
    /// \return true.
    /// \throws Exception "Pin ... not found.\n", "Invalid Name.\n" for a null name, "Invalid
    ///         attribute type.\n".
    bool AddInstancePinAttr(const Port::TextArgument& instance, const Port::TextArgument& pin,
                            const Port::TextArgument& name, const Port::TextArgument& value,
                            const Port::TextArgument& type);

    /// Sets the value of a holder's attribute; null is read as "".
    /// \return false, nothing done, for a null holder, else true.
    /// \throws Exception "Attribute ... not found.\n".
    bool SetAttrValue(AttributeHolder* holder, const Port::TextArgument& attribute,
                      const Port::TextArgument& value);
    /// Sets the generic option of a holder's attribute.
    /// \param value "NONE", "SYN" or "NOSYN", letter case ignored.
    /// \return false, nothing done, for a null holder, else true.
    /// \throws Exception "Attribute ... not found.\n", "Invalid generic value.\n".
    bool SetGenericAttrValue(AttributeHolder* holder, const Port::TextArgument& attribute,
                             const Port::TextArgument& value);
    /// Sets the synthesis option of a holder's attribute.
    /// \param value "NONE", "ASSIGN" or "ASSIGNNODEC", letter case ignored.
    /// \return false, nothing done, for a null holder, else true.
    /// \throws Exception "Attribute ... not found.\n", "Invalid generic value.\n".
    bool SetSynAttrValue(AttributeHolder* holder, const Port::TextArgument& attribute,
                         const Port::TextArgument& value);
    /// Names the type of a holder's attribute, which has to be an `AttributeUser`.
    /// \return false, nothing done, for a null holder, else true.
    /// \throws Exception "Attribute ... not found.\n", "Invalid attribute type.\n".
    bool SetUserType(AttributeHolder* holder, const Port::TextArgument& attribute,
                     const Port::TextArgument& type);

    /// Sets the value of an attribute of the module, as `SetAttrValue` does.
    /// \return true.
    /// \throws Exception "Attribute ... not found.\n".
    bool SetModuleAttrValue(const Port::TextArgument& attribute, const Port::TextArgument& value);
    /// Sets the value of an attribute of a component, as `SetAttrValue` does.
    /// \return true.
    /// \throws Exception "... not found.\n", "Attribute ... not found.\n".
    bool SetComponentAttrValue(const Port::TextArgument& component,
                               const Port::TextArgument& attribute,
                               const Port::TextArgument& value);
    /// Sets the value of an attribute of an instance, or of its component, as `SetAttrValue` does.
    /// \return true.
    /// \throws Exception "... not found.\n", "Attribute ... not found.\n".
    bool SetInstanceAttrValue(const Port::TextArgument& instance,
                              const Port::TextArgument& attribute, const Port::TextArgument& value);
    /// Sets the value of an attribute of a signal, as `SetAttrValue` does.
    /// \return true.
    /// \throws Exception "... not found.\n", "Attribute ... not found.\n".
    bool SetSignalAttrValue(const Port::TextArgument& signal, const Port::TextArgument& attribute,
                            const Port::TextArgument& value);
    /// Sets the value of an attribute of a pin of a component, as `SetAttrValue` does.
    /// \return true.
    /// \throws Exception "Pin ... not found.\n", "Attribute ... not found.\n".
    bool SetComponentPinAttrValue(const Port::TextArgument& component,
                                  const Port::TextArgument& pin,
                                  const Port::TextArgument& attribute,
                                  const Port::TextArgument& value);
    /// Sets the value of an attribute of a pin of an instance, as `SetAttrValue` does.
    /// \return true.
    /// \throws Exception "Pin ... not found.\n", "Attribute ... not found.\n".
    bool SetInstancePinAttrValue(const Port::TextArgument& instance, const Port::TextArgument& pin,
                                 const Port::TextArgument& attribute,
                                 const Port::TextArgument& value);

    /// Sets the generic option of an attribute of the module, as `SetGenericAttrValue` does.
    /// \return true.
    /// \throws Exception "Attribute ... not found.\n", "Invalid generic value.\n".
    bool SetModuleGenericAttrValue(const Port::TextArgument& attribute,
                                   const Port::TextArgument& value);
    /// Sets the generic option of an attribute of a component, as `SetGenericAttrValue` does.
    /// \return true.
    /// \throws Exception "... not found.\n", "Attribute ... not found.\n", "Invalid generic
    ///         value.\n".
    bool SetComponentGenericAttrValue(const Port::TextArgument& component,
                                      const Port::TextArgument& attribute,
                                      const Port::TextArgument& value);
    /// Sets the generic option of an attribute of an instance, or of its component, as
    /// `SetGenericAttrValue` does.
    /// \return true.
    /// \throws Exception "... not found.\n", "Attribute ... not found.\n", "Invalid generic
    ///         value.\n".
    bool SetInstanceGenericAttrValue(const Port::TextArgument& instance,
                                     const Port::TextArgument& attribute,
                                     const Port::TextArgument& value);
    /// Sets the generic option of an attribute of a signal, as `SetGenericAttrValue` does.
    /// \return true.
    /// \throws Exception "... not found.\n", "Attribute ... not found.\n", "Invalid generic
    ///         value.\n".
    bool SetSignalGenericAttrValue(const Port::TextArgument& signal,
                                   const Port::TextArgument& attribute,
                                   const Port::TextArgument& value);
    /// Sets the generic option of an attribute of a pin of a component, as `SetGenericAttrValue`
    /// does.
    /// \return true.
    /// \throws Exception "Pin ... not found.\n", "Attribute ... not found.\n", "Invalid generic
    ///         value.\n".
    bool SetComponentPinGenericAttrValue(const Port::TextArgument& component,
                                         const Port::TextArgument& pin,
                                         const Port::TextArgument& attribute,
                                         const Port::TextArgument& value);
    /// Sets the generic option of an attribute of a pin of an instance, as `SetGenericAttrValue`
    /// does.
    /// \return true.
    /// \throws Exception "Pin ... not found.\n", "Attribute ... not found.\n", "Invalid generic
    ///         value.\n".
    bool SetInstancePinGenericAttrValue(const Port::TextArgument& instance,
                                        const Port::TextArgument& pin,
                                        const Port::TextArgument& attribute,
                                        const Port::TextArgument& value);

    /// Sets the synthesis option of an attribute of the module, as `SetSynAttrValue` does.
    /// \return true.
    /// \throws Exception "Attribute ... not found.\n", "Invalid generic value.\n".
    bool SetModuleSynAttrValue(const Port::TextArgument& attribute,
                               const Port::TextArgument& value);
    /// Sets the synthesis option of an attribute of a component, as `SetSynAttrValue` does.
    /// \return true.
    /// \throws Exception "... not found.\n", "Attribute ... not found.\n", "Invalid generic
    ///         value.\n".
    bool SetComponentSynAttrValue(const Port::TextArgument& component,
                                  const Port::TextArgument& attribute,
                                  const Port::TextArgument& value);
    /// Sets the synthesis option of an attribute of an instance, or of its component, as
    /// `SetSynAttrValue` does.
    /// \return true.
    /// \throws Exception "... not found.\n", "Attribute ... not found.\n", "Invalid generic
    ///         value.\n".
    bool SetInstanceSynAttrValue(const Port::TextArgument& instance,
                                 const Port::TextArgument& attribute,
                                 const Port::TextArgument& value);
    /// Sets the synthesis option of an attribute of a signal, as `SetSynAttrValue` does.
    /// \return true.
    /// \throws Exception "... not found.\n", "Attribute ... not found.\n", "Invalid generic
    ///         value.\n".
    bool SetSignalSynAttrValue(const Port::TextArgument& signal,
                               const Port::TextArgument& attribute,
                               const Port::TextArgument& value);
    /// Sets the synthesis option of an attribute of a pin of a component, as `SetSynAttrValue`
    /// does.
    /// \return true.
    /// \throws Exception "Pin ... not found.\n", "Attribute ... not found.\n", "Invalid generic
    ///         value.\n".
    bool SetComponentPinSynAttrValue(const Port::TextArgument& component,
                                     const Port::TextArgument& pin,
                                     const Port::TextArgument& attribute,
                                     const Port::TextArgument& value);
    /// Sets the synthesis option of an attribute of a pin of an instance, as `SetSynAttrValue`
    /// does.
    /// \return true.
    /// \throws Exception "Pin ... not found.\n", "Attribute ... not found.\n", "Invalid generic
    ///         value.\n".
    bool SetInstancePinSynAttrValue(const Port::TextArgument& instance,
                                    const Port::TextArgument& pin,
                                    const Port::TextArgument& attribute,
                                    const Port::TextArgument& value);

    /// Names the type of an attribute of the module, as `SetUserType` does.
    /// \return true.
    /// \throws Exception "Attribute ... not found.\n", "Invalid attribute type.\n".
    bool SetModuleUserType(const Port::TextArgument& attribute, const Port::TextArgument& type);
    /// Names the type of an attribute of a component, as `SetUserType` does.
    /// \return true.
    /// \throws Exception "... not found.\n", "Attribute ... not found.\n", "Invalid attribute
    ///         type.\n".
    bool SetComponentUserType(const Port::TextArgument& component,
                              const Port::TextArgument& attribute, const Port::TextArgument& type);
    /// Names the type of an attribute of an instance, or of its component, as `SetUserType` does.
    /// \return true.
    /// \throws Exception "... not found.\n", "Attribute ... not found.\n", "Invalid attribute
    ///         type.\n".
    bool SetInstanceUserType(const Port::TextArgument& instance,
                             const Port::TextArgument& attribute, const Port::TextArgument& type);
    /// Names the type of an attribute of a signal, as `SetUserType` does.
    /// \return true.
    /// \throws Exception "... not found.\n", "Attribute ... not found.\n", "Invalid attribute
    ///         type.\n".
    bool SetSignalUserType(const Port::TextArgument& signal, const Port::TextArgument& attribute,
                           const Port::TextArgument& type);
    /// Names the type of an attribute of a pin of a component, as `SetUserType` does.
    /// \return true.
    /// \throws Exception "Pin ... not found.\n", "Attribute ... not found.\n", "Invalid attribute
    ///         type.\n".
    bool SetComponentPinUserType(const Port::TextArgument& component, const Port::TextArgument& pin,
                                 const Port::TextArgument& attribute,
                                 const Port::TextArgument& type);
    /// Names the type of an attribute of a pin of an instance, as `SetUserType` does.
    /// \return true.
    /// \throws Exception "Pin ... not found.\n", "Attribute ... not found.\n", "Invalid attribute
    ///         type.\n".
    bool SetInstancePinUserType(const Port::TextArgument& instance, const Port::TextArgument& pin,
                                const Port::TextArgument& attribute,
                                const Port::TextArgument& type);

    /// Adds a line to the module's comment; null adds nothing.
    /// \return true.
    bool AddNotes(const Port::TextArgument& text);
    /// Adds a line to the comment of a component; null is read as "".
    /// \return true.
    /// \throws Exception "... not found.\n".
    bool AddComponentComment(const Port::TextArgument& component, const Port::TextArgument& text);
    /// Adds a line to the comment of an instance; null is read as "".
    /// \return true.
    /// \throws Exception "... not found.\n".
    bool AddInstanceComment(const Port::TextArgument& instance, const Port::TextArgument& text);
    /// Adds a line to the comment of a signal; null is read as "".
    /// \return true.
    /// \throws Exception "... not found.\n".
    bool AddSignalComment(const Port::TextArgument& signal, const Port::TextArgument& text);
    /// Adds a line to the comment of a pin of a component; null adds nothing.
    /// \return true.
    /// \throws Exception "Pin ... not found.\n".
    bool AddComponentPinComment(const Port::TextArgument& component, const Port::TextArgument& pin,
                                const Port::TextArgument& text);
    /// Adds a line to the comment of a pin of an instance; null adds nothing.
    /// \return true.
    /// \throws Exception "Pin ... not found.\n".
    bool AddInstancePinComment(const Port::TextArgument& instance, const Port::TextArgument& pin,
                               const Port::TextArgument& text);

private:
    friend class Engine;
    struct Implementation;

    /// Deletes a model, or, while there is a `Use` of it, leaves that to the last `Use`. Null is
    /// ignored.
    static void Delete(std::unique_ptr<Model> model) noexcept;

    bool IsNamedUsed(const char* name) const;

    /// These change the netlist without setting the modified flag: the operation that calls them
    /// may fail yet.
    void DeclareSignal(const char* name);
    Signal* GetOrCreateSignal(const char* name);
    Signal* CreateAndAddBusIndexSignal(std::string_view name);
    Signal* CreateAndAddBusSliceSignal(std::string_view name);
    Signal* CreateAndAddCompundSignal(std::string_view name);
    Signal* GetOrCreateMember(std::string_view name);
    bool Connect(Signal* signal, Pin* pin);
    bool Connect(Signal* first, Signal* second);
    bool AssignConstant(Signal* signal, const char* value);
    bool AssignConstant(Pin* pin, const char* value, const char* instance);

    std::unique_ptr<Implementation> implementation_;
    /// The innermost use, and whether the last one deletes the model.
    Use* innermostUse_ = nullptr;
    bool endsUnused_ = false;
};

} // namespace Orn_Hdl
