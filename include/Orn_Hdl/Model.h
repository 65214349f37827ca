/// \file
/// `Model`, one design and every operation on it by name, and with it every header of the design.
#pragma once

#include "Orn_Hdl/Attributes.h"
#include "Orn_Hdl/Containers/StringArray.h"
#include "Orn_Hdl/Model/Component.h"
#include "Orn_Hdl/Model/Netlist.h"
#include "Orn_Hdl/Model/Object.h"
#include "Orn_Hdl/Model/Pins.h"
#include "Orn_Hdl/Model/Signals.h"
#include "Orn_Hdl/Options.h"
#include "Port/Export.h"
#include "Port/String.h"

#include <cstddef>
#include <memory>
#include <string_view>

namespace Orn_Hdl {

class CommandFactory;
class CommandManager;
class Engine;

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
};

/// One design: its netlist, its output options and its done commands.
///
/// Every operation takes plain texts, looks the named objects up, checks them, and throws
/// `Orn_Hdl::Exception` with a fixed message when a check fails; nothing that was done before is
/// undone. A null name reads as "" in every look-up. Operations that change the design set the
/// modified flag, but for `SetName` and `SetSourceFileName`.
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
    /// Sets or clears the flag.
    void SetModifiedFlag(bool modified) noexcept;

    /// \{
    /// What the model owns; never null.
    Netlist* GetNetlist() noexcept;
    const Netlist* GetNetlist() const noexcept;
    HdlOptions* GetOptions() noexcept;
    /// \}
    /// The factory that was given, which the model does not own.
    CommandFactory* GetCommandFactory() const noexcept;
    /// The done commands, owned by the model.
    CommandManager* GetCommandManager() noexcept;

    /// The netlist's name.
    Port::StringBase<char> GetName() const;
    /// Null gives "HDL_NETLIST".
    void SetName(const char* name);
    /// \{
    /// The file from which the design comes.
    Port::StringBase<char> GetSourceFileName() const;
    void SetSourceFileName(const char* name);
    /// \}

    /// Splits a command line and runs it. An empty line does nothing.
    /// \return true whenever no exception is thrown.
    bool Execute(const char* text);
    /// As above, for a text of known length that ends at its first NUL.
    bool ExecuteLine(std::string_view line);
    /// As above, for a line that has been split.
    bool Execute(const StringArray& tokens);
    /// Hints that a line, split, will be executed `ForeseenLines` lines later, so that in a large
    /// design what it names is fetched in the meantime. Changes nothing.
    void Foresee(const StringArray& words) noexcept;
    /// How many lines `Foresee` looks ahead.
    static constexpr std::size_t ForeseenLines = 16;
    /// Replays a command file and clears the modified flag. An exception of a line ends the replay.
    /// \return false when the file cannot be opened or read.
    bool Read(const char* fileName);
    /// Clears the modified flag and returns true; done commands are kept in memory only.
    bool Write(const char* fileName);

    /// \{
    /// Who is asked before a write command opens its file. What it refuses fails the command, which
    /// then changes nothing. Not owned; null, as at first, when every file may be written.
    void SetOutputGuard(OutputGuard* guard) noexcept;
    OutputGuard* GetOutputGuard() const noexcept;
    /// \}
    /// What became of the last netlist that a write command wrote: the file's name and the system's
    /// error number, 0 when every byte was written.
    void RecordWrite(const char* fileName, int error);
    /// The error number of the last write.
    int GetWriteError() const noexcept;
    /// The file name of the last write.
    Port::StringBase<char> GetWrittenFileName() const;

    /// \{
    /// The object of that name, which the design owns; null when there is none, or no owner.
    Component* GetComponent(const char* name) const;
    Instance* GetInstance(const char* name) const;
    Signal* GetSignal(const char* name) const;
    Pin* GetPin(const char* name, const Component* component) const;
    Pin* GetPin(const char* name, const Instance* instance) const;
    Attribute* GetAttr(const char* name, const AttributeHolder* holder) const;
    /// \}

    /// Declares a component without pins. Components, instances and signals share one name space.
    /// \throws Exception "Identifier ... already defined.\n" when the name is taken.
    bool AddComponent(const char* name);
    /// Appends a pin to a component; a default value that is not empty is taken. Instances that are
    /// there already do not get it.
    /// \throws Exception "Component ... not found.\n", "Component ... already has pin ...\n".
    bool AddPin(const char* name, const Polarity& polarity, const char* component,
                const char* defaultValue);
    /// Places a component: the instance gets its own copies of the component's pins, all open.
    /// \throws Exception "Identifier ... already defined.\n", "Component ... not found.\n".
    bool AddInstance(const char* name, const char* component);
    /// Declares a signal, or a bus when the name has a range. It is no port until it is given a
    /// polarity.
    /// \throws Exception "Identifier ... already defined.\n", or, for a bus whose base name another
    ///         bus has, "Signal ... already declared.\n".
    bool AddSignal(const char* name);
    /// Wires a pin to a signal, which is declared as by `AddSignal` when it is not there.
    /// \throws Exception "Signal ... not found.\n" for an instance that is not there, and for a bit
    ///         of a bus that is not there; "Pin ... not found.\n".
    bool ConnectSignalToPin(const char* signal, const char* instance, const char* pin);
    /// Makes the second signal an alias of the first; both are declared likewise.
    /// \throws Exception "Signal ... not found.\n" for a bit of a bus that is not there.
    bool ConnectSignals(const char* first, const char* second);
    /// Ties a signal to a constant; it is declared likewise.
    /// \param value digits, or LENGTH:BASE:DIGITS as `BitVectorValue` reads it; not checked.
    /// \throws Exception "Signal ... not found.\n" for a bit of a bus that is not there.
    bool AssignConstantToSignal(const char* signal, const char* value);
    /// Wires a pin to a signal of its own that carries the constant.
    /// \throws Exception "Signal ... not found.\n" for an instance that is not there, "Pin ... not
    ///         found.\n".
    bool AssignConstantToPin(const char* instance, const char* pin, const char* value);

    /// Adds an attribute, or gives one that is present another value, its type kept.
    /// \param type one of the seven type names; null means "String".
    /// \return false for a null holder, else true.
    /// \throws Exception "Invalid attribute type.\n".
    bool AddAttr(AttributeHolder* holder, const char* name, const char* value, const char* type);
    /// \{
    /// The same on an object by its name. What is not there throws "... not found.\n", a null
    /// attribute name "Invalid Name.\n".
    bool AddModuleAttr(const char* name, const char* value, const char* type);
    bool AddComponentAttr(const char* component, const char* name, const char* value,
                          const char* type);
    bool AddInstanceAttr(const char* instance, const char* name, const char* value,
                         const char* type);
    bool AddSignalAttr(const char* signal, const char* name, const char* value, const char* type);
    bool AddComponentPinAttr(const char* component, const char* pin, const char* name,
                             const char* value, const char* type);
    bool AddInstancePinAttr(const char* instance, const char* pin, const char* name,
                            const char* value, const char* type);
    /// \}

    /// \{
    /// Operations on one attribute of a holder: its value; its generic option "NONE", "SYN" or
    /// "NOSYN"; its synthesis option "NONE", "ASSIGN" or "ASSIGNNODEC"; the name of its type when
    /// that is User.
    /// \return false, nothing done, for a null holder, else true.
    /// \throws Exception "Attribute ... not found.\n", "Invalid generic value.\n" for any other
    ///         option, "Invalid attribute type.\n" for a type name on an attribute that is not
    ///         User.
    bool SetAttrValue(AttributeHolder* holder, const char* attribute, const char* value);
    bool SetGenericAttrValue(AttributeHolder* holder, const char* attribute, const char* value);
    bool SetSynAttrValue(AttributeHolder* holder, const char* attribute, const char* value);
    bool SetUserType(AttributeHolder* holder, const char* attribute, const char* value);
    /// \}

    /// \{
    /// The same by the object's name; an instance's attribute is looked for on its component too.
    /// What is not there throws "... not found.\n".
    bool SetModuleAttrValue(const char* attribute, const char* value);
    bool SetComponentAttrValue(const char* component, const char* attribute, const char* value);
    bool SetInstanceAttrValue(const char* instance, const char* attribute, const char* value);
    bool SetSignalAttrValue(const char* signal, const char* attribute, const char* value);
    bool SetComponentPinAttrValue(const char* component, const char* pin, const char* attribute,
                                  const char* value);
    bool SetInstancePinAttrValue(const char* instance, const char* pin, const char* attribute,
                                 const char* value);

    bool SetModuleGenericAttrValue(const char* attribute, const char* value);
    bool SetComponentGenericAttrValue(const char* component, const char* attribute,
                                      const char* value);
    bool SetInstanceGenericAttrValue(const char* instance, const char* attribute,
                                     const char* value);
    bool SetSignalGenericAttrValue(const char* signal, const char* attribute, const char* value);
    bool SetComponentPinGenericAttrValue(const char* component, const char* pin,
                                         const char* attribute, const char* value);
    bool SetInstancePinGenericAttrValue(const char* instance, const char* pin,
                                        const char* attribute, const char* value);

    bool SetModuleSynAttrValue(const char* attribute, const char* value);
    bool SetComponentSynAttrValue(const char* component, const char* attribute, const char* value);
    bool SetInstanceSynAttrValue(const char* instance, const char* attribute, const char* value);
    bool SetSignalSynAttrValue(const char* signal, const char* attribute, const char* value);
    bool SetComponentPinSynAttrValue(const char* component, const char* pin, const char* attribute,
                                     const char* value);
    bool SetInstancePinSynAttrValue(const char* instance, const char* pin, const char* attribute,
                                    const char* value);

    bool SetModuleUserType(const char* attribute, const char* type);
    bool SetComponentUserType(const char* component, const char* attribute, const char* type);
    bool SetInstanceUserType(const char* instance, const char* attribute, const char* type);
    bool SetSignalUserType(const char* signal, const char* attribute, const char* type);
    bool SetComponentPinUserType(const char* component, const char* pin, const char* attribute,
                                 const char* type);
    bool SetInstancePinUserType(const char* instance, const char* pin, const char* attribute,
                                const char* type);
    /// \}

    /// Adds a line to the module's comment; null adds nothing.
    bool AddNotes(const char* text);
    /// \{
    /// The same to the comment of an object by its name; what is not there throws "... not
    /// found.\n".
    bool AddComponentComment(const char* component, const char* text);
    bool AddInstanceComment(const char* instance, const char* text);
    bool AddSignalComment(const char* signal, const char* text);
    bool AddComponentPinComment(const char* component, const char* pin, const char* text);
    bool AddInstancePinComment(const char* instance, const char* pin, const char* text);
    /// \}

private:
    friend class Engine;
    struct Implementation;

    /// Deletes a model, or, while there is a `Use` of it, leaves that to the last one. Null is
    /// ignored.
    static void Delete(std::unique_ptr<Model> model) noexcept;

    bool IsNamedUsed(const char* name) const;
    Component* FindComponent(const char* name) const;
    Instance* FindInstance(const char* name) const;
    Signal* FindSignal(const char* name) const;
    Pin* FindComponentPin(const char* component, const char* pin) const;
    Pin* FindInstancePin(const char* instance, const char* pin) const;
    Attribute* FindAttr(const char* name, const AttributeHolder* holder) const;
    Attribute* FindInstanceAttr(const char* instance, const char* attribute) const;
    Attribute* GetInstanceOrComponentAttr(const char* name, const Instance* instance) const;

    bool SetAttrValue(Attribute* attribute, const char* value);
    bool SetGenericAttrValue(Attribute* attribute, const char* value);
    bool SetSynAttrValue(Attribute* attribute, const char* value);
    bool SetUserType(Attribute* attribute, const char* type);
    bool AddComment(Object& object, const char* text);

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
