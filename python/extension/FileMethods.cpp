// Functions that read and write files, check a design and prove what was written. Other threads run
// meanwhile.
#include "Objects.h"

#include <optional>
#include <string>

namespace Python {

namespace {

using Orn_Hdl::Check;
using Orn_Hdl::Language;
using Orn_Hdl::Model;

Language GetLanguage(const Arguments& arguments, Py_ssize_t i) {
    return arguments.GetInt(i) == 0 ? Language::Verilog : Language::Vhdl;
}

[[noreturn]] void ThrowSystemError(int error, const char* file) {
    errno = error;
    const Ref name = MakeText(file);
    PyErr_SetFromErrnoWithFilenameObject(PyExc_OSError, name.Get());
    throw ErrorIsSet();
}

/// Where a replay has failed.
struct Stopped {
    std::uint64_t line = 0;
    std::string command;
};

/// Executes some lines. \return whether there are more.
bool ReplaySome(Model& model, Orn_Hdl::CommandReader& reader, Stopped& place) {
    constexpr int AtOnce = 1 << 16;
    for (int i = 0; i < AtOnce; ++i) {
        const Orn_Hdl::StringArray* const words = reader.Next();
        if (words == nullptr) {
            return false;
        }
        ++place.line;
        try {
            model.Execute(*words);
        } catch (const Orn_Hdl::Exception&) {
            place.command = words->JoinFrom(0);
            throw;
        }
    }
    return true;
}

/// Signals of the system, such as an interrupt by the user, are looked at from time to time.
Ref ReadCommands(ModelState& state, Arguments& arguments) {
    Model& model = state.Get();
    const char* const file = arguments.GetText(0);
    Orn_Hdl::CommandReader reader(model);
    bool isOpen = false;
    {
        // A pipe is open when somebody writes into it, which may be another thread.
        const Unlocked unlocked;
        isOpen = reader.Open(file);
    }
    if (!isOpen) {
        ThrowSystemError(reader.GetError() != 0 ? reader.GetError() : ENOENT, file);
    }
    Stopped place;
    try {
        for (bool isMore = true; isMore;) {
            {
                const Unlocked unlocked;
                isMore = ReplaySome(model, reader, place);
            }
            if (PyErr_CheckSignals() != 0) {
                throw ErrorIsSet();
            }
        }
    } catch (const Orn_Hdl::Exception&) {
        RethrowForCommand(place.command, file, place.line);
    }
    if (reader.GetError() != 0) {
        ThrowSystemError(reader.GetError(), file);
    }
    return Ref::None();
}

/// Language, file, whether to append, whether with a header. The write command does the work.
Ref WriteNetlist(ModelState& state, Arguments& arguments) {
    Model& model = state.Get();
    const char* const file = arguments.GetText(1);
    Orn_Hdl::StringArray words;
    words.Add("WRITE");
    words.Add(GetLanguage(arguments, 0) == Language::Verilog ? "VERILOG" : "VHDL");
    words.Add(arguments.GetBool(2) ? "-APPEND" : "-OVERWRITE");
    if (!arguments.GetBool(3)) {
        words.Add("-NOHEADER");
    }
    words.Add(file);
    {
        const Unlocked unlocked;
        model.Execute(words);
    }
    if (model.GetWriteError() != 0) {
        ThrowSystemError(model.GetWriteError(), file);
    }
    return Ref::None();
}

Ref GetCommands(ModelState& state, Arguments& /*arguments*/) {
    const Model& model = state.Get();
    Orn_Hdl::TextMemOutStream text;
    {
        const Unlocked unlocked;
        model.WriteCommands(text);
    }
    return MakeText(text.GetValue());
}

Ref WriteCommands(ModelState& state, Arguments& arguments) {
    const Model& model = state.Get();
    const char* const file = arguments.GetText(0);
    int error = 0;
    {
        const Unlocked unlocked;
        Orn_Hdl::TextFileOutStream out(file, Orn_Hdl::TextFileOutStream::Replace);
        if (out.IsOpen()) {
            model.WriteCommands(out);
            out.Close();
        }
        error = out.GetError();
    }
    if (error != 0) {
        ThrowSystemError(error, file);
    }
    return Ref::None();
}

Check::Targets TakeTargets(PyObject* list) {
    Check::Targets targets;
    for (const std::string& name : TakeTexts(list)) {
        Check::Target target = Check::Target::Verilog1995;
        if (!Check::FindTarget(name, target)) {
            PyErr_Format(PyExc_ValueError, "there is no target %s", name.c_str());
            throw ErrorIsSet();
        }
        targets.Add(target);
    }
    return targets.IsEmpty() ? Check::Targets::All() : targets;
}

Ref MakeTargets(const Check::Finding& finding) {
    Ref list = MakeList();
    for (const Check::Verdict verdict :
         {Check::Verdict::Rejects, Check::Verdict::Misreads, Check::Verdict::Warns}) {
        for (const Check::Target target : finding.GetTargets(verdict)) {
            Append(list, MakeText(Check::GetName(target)));
        }
    }
    return list;
}

/// Rule, whether an error, message, notes, help, targets.
Ref MakeFindings(const std::vector<Check::Finding>& findings) {
    Ref list = MakeList();
    for (const Check::Finding& finding : findings) {
        const Ref notes = MakeList();
        for (const std::string& note : finding.notes) {
            Append(notes, MakeText(note));
        }
        Append(list, MakeTuple(MakeText(finding.rule->name),
                               MakeBool(finding.GetSeverity() == Check::Severity::Error),
                               MakeText(finding.message), Ref::Share(notes.Get()),
                               MakeText(finding.rule->help), MakeTargets(finding)));
    }
    return list;
}

Ref RunCheck(ModelState& state, Arguments& arguments) {
    Model& model = state.Get();
    const Check::Targets targets = TakeTargets(arguments.Get(0));
    std::vector<Check::Finding> findings;
    {
        const Unlocked unlocked;
        findings = Check::Run(*model.GetNetlist(), *model.GetOptions(), targets);
    }
    return MakeFindings(findings);
}

/// What no legal netlist can mend.
Ref FindIllegal(ModelState& state, Arguments& /*arguments*/) {
    Model& model = state.Get();
    std::optional<Orn_Hdl::LegalNetlist> legal;
    {
        const Unlocked unlocked;
        legal.emplace(*model.GetNetlist(), *model.GetOptions());
    }
    return MakeFindings(legal->GetErrors());
}

std::vector<Orn_Hdl::Proof::Difference> CompareWith(Model& model, Language language,
                                                    const char* file) {
    Orn_Hdl::OutStream nothing(nullptr);
    std::optional<Orn_Hdl::LegalNetlist> legal;
    if (model.GetOptions()->legal) {
        legal.emplace(*model.GetNetlist(), *model.GetOptions());
        legal->Write(language, nothing);
        return Orn_Hdl::Proof::Compare(file, language, legal->GetWrittenNetlist(),
                                       legal->GetWrittenOptions());
    }
    if (language == Language::Verilog) {
        Orn_Hdl::VerilogNetlister(nothing).WriteNetlist(model.GetNetlist(), *model.GetOptions());
    } else {
        Orn_Hdl::VhdlNetlister(nothing).WriteNetlist(model.GetNetlist(), model.GetOptions());
    }
    return Orn_Hdl::Proof::Compare(file, language, *model.GetNetlist(), *model.GetOptions());
}

/// Language, file. Message, line, column, text of the line.
Ref VerifyNetlist(ModelState& state, Arguments& arguments) {
    Model& model = state.Get();
    const Language language = GetLanguage(arguments, 0);
    const char* const file = arguments.GetText(1);
    std::vector<Orn_Hdl::Proof::Difference> differences;
    {
        const Unlocked unlocked;
        // A legal netlist keeps the copy that is compared only for the sake of a proof.
        bool& verify = model.GetOptions()->verify;
        const bool before = std::exchange(verify, true);
        try {
            differences = CompareWith(model, language, file);
        } catch (...) {
            verify = before;
            throw;
        }
        verify = before;
    }
    return MakeDifferences(differences);
}

Ref MakeRenamings(const std::vector<Orn_Hdl::ReaderRenaming>& renamings) {
    Ref list = MakeList();
    for (const Orn_Hdl::ReaderRenaming& renaming : renamings) {
        Append(list, MakeTuple(MakeText(renaming.name), MakeText(renaming.newName)));
    }
    return list;
}

Orn_Hdl::ReaderNames GetReaderNames(bool literal) noexcept {
    return literal ? Orn_Hdl::ReaderNames::Literal : Orn_Hdl::ReaderNames::Simple;
}

/// Calls `Read` of a reader, after which objects of the netlist may be others.
template <class Reader> Ref ReadNetlist(Reader& reader, ModelState& state, const char* file) {
    Model& model = state.Get();
    state.ForgetObjects();
    try {
        const Unlocked unlocked;
        reader.Read(file, model);
    } catch (const Orn_Hdl::Exception& exception) {
        throw Failure{"netlist", std::string(exception.getLocalized().GetView()), file};
    }
    return MakeRenamings(reader.GetRenamings());
}

/// File, top, libraries, folders, names of macros, their texts, whether to keep names, whether to
/// infer undeclared modules, whether to keep don't cares.
Ref ReadVerilog(ModelState& state, Arguments& arguments) {
    Orn_Hdl::VerilogReader reader;
    reader.SetTop(arguments.GetText(1));
    for (const std::string& library : TakeTexts(arguments.Get(2))) {
        reader.AddLibrary(library.c_str());
    }
    for (const std::string& folder : TakeTexts(arguments.Get(3))) {
        reader.AddIncludeFolder(folder.c_str());
    }
    const std::vector<std::string> macros = TakeTexts(arguments.Get(4));
    const std::vector<std::string> texts = TakeTexts(arguments.Get(5));
    for (std::size_t i = 0; i < macros.size() && i < texts.size(); ++i) {
        reader.Define(macros[i].c_str(), texts[i].c_str());
    }
    reader.SetNames(GetReaderNames(arguments.GetBool(6)));
    reader.SetUndeclared(arguments.GetBool(7) ? Orn_Hdl::ReaderUndeclared::Infer
                                              : Orn_Hdl::ReaderUndeclared::Refuse);
    reader.KeepDontCares(arguments.GetBool(8));
    reader.KeepComments(true);
    return ReadNetlist(reader, state, arguments.GetText(0));
}

/// File, top, libraries, whether to keep names, whether to keep don't cares.
Ref ReadVhdl(ModelState& state, Arguments& arguments) {
    Orn_Hdl::VhdlReader reader;
    reader.SetTop(arguments.GetText(1));
    for (const std::string& library : TakeTexts(arguments.Get(2))) {
        reader.AddLibrary(library.c_str());
    }
    reader.SetNames(GetReaderNames(arguments.GetBool(3)));
    reader.KeepDontCares(arguments.GetBool(4));
    reader.KeepComments(true);
    return ReadNetlist(reader, state, arguments.GetText(0));
}

} // namespace

const std::vector<PyMethodDef> FileMethods = {
    Row<ReadCommands, 1>("read_commands"),
    Row<WriteNetlist, 4>("write"),
    Row<GetCommands, 0>("commands"),
    Row<WriteCommands, 1>("write_commands"),
    Row<RunCheck, 1>("check"),
    Row<FindIllegal, 0>("find_illegal"),
    Row<VerifyNetlist, 2>("verify"),
    Row<ReadVerilog, 9>("read_verilog"),
    Row<ReadVhdl, 5>("read_vhdl"),
};

} // namespace Python
