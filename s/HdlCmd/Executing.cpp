#include "HdlCmd/Executing.h"

#include "Exception/Failure.h"
#include "HdlModel/ModelUse.h"
#include "Orn_Hdl/LegalNetlist.h"
#include "Orn_Hdl/Proof.h"
#include "Orn_Hdl/Streams.h"
#include "Orn_Hdl/Writers.h"
#include "Port/Ascii.h"

#include <optional>

namespace Orn_Hdl {

void ExecuteAddPin(Model& model, const Arguments& arguments) {
    model.AddPin(arguments.Get(0), Polarity(arguments.Get(1)), arguments.Get(2), arguments.Get(3));
}

void ExecuteAddPort(Model& model, const Arguments& arguments) {
    if (model.AddSignal(arguments.Get(0))) {
        if (Signal* signal = model.GetSignal(arguments.Get(0))) {
            signal->SetPortPolarity(Polarity(arguments.Get(1)));
        }
    }
}

void ExecuteConnection(Model& model, const Arguments& arguments) {
    if (arguments.Has(TargetFlag::Pin)) {
        model.ConnectSignalToPin(arguments.Get(0), arguments.Get(1), arguments.Get(2));
    } else {
        model.ConnectSignals(arguments.Get(0), arguments.Get(1));
    }
}

void ExecuteConstant(Model& model, const Arguments& arguments) {
    if (arguments.Has(TargetFlag::Pin)) {
        model.AssignConstantToPin(arguments.Get(0), arguments.Get(1), arguments.Get(2));
    } else {
        model.AssignConstantToSignal(arguments.Get(0), arguments.Get(1));
    }
}

void ExecuteSetSynthesis(Model& model, const Arguments& arguments) {
    model.GetOptions()->verilog.SetSynthesisType(arguments.Get(0));
}

namespace {

void RequirePermission(const Model& model, const char* fileName) {
    OutputGuard* const guard = model.GetOutputGuard();
    if (guard == nullptr) {
        return;
    }
    const Port::StringBase<char> reason = guard->WhyNot(fileName);
    if (!reason.IsEmpty()) {
        Fail(CommandUnit, __LINE__, "Cannot write \"%s\": %s.\n",
             {Port::ViewOf(fileName), reason.GetView()});
    }
}

/// Opens a file in the folder that the model's guard keeps open, or by its name if there is none.
TextFileOutStream Open(const Model& model, const char* fileName, TextFileOutStream::Mode mode) {
    OutputGuard* const guard = model.GetOutputGuard();
    Port::StringBase<char> path;
    const Port::Folder* const folder =
        guard == nullptr ? nullptr : guard->GetFolder(fileName, path);
    if (folder == nullptr) {
        return TextFileOutStream(fileName, mode);
    }
    return TextFileOutStream(*folder, path.CStr(), fileName, mode);
}

/// Opens the file, lets `write` write into it, closes it, and records the outcome in the model. An
/// existing file is replaced once everything has been written, and stays as it is otherwise.
template <class Write>
void WriteFile(Model& model, const Arguments& arguments, Language language, Write write) {
    const char* const fileName = arguments.Get(0);
    const Model::Use use(&model);
    RequirePermission(model, fileName);
    if (!use.HasModel()) {
        return;
    }
    std::optional<LegalNetlist> legal;
    if (model.GetOptions()->legal) {
        // A design that cannot be written leaves the file alone.
        legal.emplace(*model.GetNetlist(), *model.GetOptions());
        legal->Prepare(language);
    }
    TextFileOutStream out = Open(model, fileName,
                                 arguments.Has(WriteFlag::Append) ? TextFileOutStream::Append
                                                                  : TextFileOutStream::Replace);
    model.GetOptions()->writeHeader = !arguments.Has(WriteFlag::WithoutHeader);
    const auto writeNetlist = [&](OutStream& stream) {
        if (legal) {
            legal->Write(language, stream);
        } else {
            write(stream, *model.GetNetlist(), *model.GetOptions());
        }
    };
    if (model.GetOptions()->verify) {
        Proof::Write(out, fileName, language, writeNetlist, [&]() -> Proof::Written {
            return legal ? Proof::Written{legal->GetWrittenNetlist(), legal->GetWrittenOptions()}
                         : Proof::Written{*model.GetNetlist(), *model.GetOptions()};
        });
    } else {
        writeNetlist(out);
    }
    out.Close();
    model.RecordWrite(fileName, out.GetError(), out.GetLeftoverSize());
}

} // namespace

void ExecuteWriteVerilog(Model& model, const Arguments& arguments) {
    WriteFile(model, arguments, Language::Verilog,
              [](OutStream& out, Netlist& netlist, HdlOptions& options) {
                  VerilogNetlister(out).WriteNetlist(&netlist, options);
              });
}

void ExecuteWriteVhdl(Model& model, const Arguments& arguments) {
    WriteFile(model, arguments, Language::Vhdl,
              [](OutStream& out, Netlist& netlist, const HdlOptions& options) {
                  VhdlNetlister(out).WriteNetlist(&netlist, &options);
              });
}

} // namespace Orn_Hdl
