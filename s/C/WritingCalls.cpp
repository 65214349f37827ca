// The functions of the C interface for writing.
#include "C/Lines.h"
#include "C/Objects.h"
#include "C/Texts.h"
#include "Orn_Hdl/Commands.h"
#include "Orn_Hdl/LegalNetlist.h"
#include "Orn_Hdl/Writers.h"

namespace CInterface = Orn_Hdl::CInterface;

using CInterface::CallFailure;
using CInterface::Change;
using CInterface::Require;
using namespace Orn_Hdl;

namespace {

/// Writes as the command does, which is not kept among the done ones.
void WriteNetlistFile(Model& model, Language language, const char* fileName, bool append) {
    StringArray words;
    words.Add("WRITE");
    words.Add(GetLanguageName(language));
    if (append) {
        words.Add("-APPEND");
    }
    if (!model.GetOptions()->writeHeader) {
        words.Add("-NOHEADER");
    }
    words.Add(fileName);
    const std::unique_ptr<Command> command(model.GetCommandFactory()->CreateCommand(&model, words));
    Require(command != nullptr && command->Parse(words));
    CInterface::ClearWriteError(model);
    command->Execute();
    CInterface::RequireWritten(model);
}

void WriteNetlistText(Model& model, Language language, OutStream& out) {
    if (language == Language::Verilog) {
        VerilogNetlister(out).WriteNetlist(model.GetNetlist(), *model.GetOptions());
    } else {
        VhdlNetlister(out).WriteNetlist(model.GetNetlist(), model.GetOptions());
    }
}

std::string NameInLegalNetlist(Model& model, const Object& object) {
    const LegalNetlist legal(*model.GetNetlist(), *model.GetOptions());
    if (legal.GetErrors().empty()) {
        return legal.GetName(object);
    }
    std::string text;
    for (const Check::Finding& finding : legal.GetErrors()) {
        text.append(text.empty() ? "" : "; ").append(finding.message);
    }
    throw CallFailure{ORN_HDL_FAILED, std::move(text)};
}

} // namespace

extern "C" {

orn_hdl_status_t orn_hdl_model_write(orn_hdl_model_t model, orn_hdl_language_t language,
                                     const char* fileName, int append) {
    return Change(model, [&](Model& target) {
        Require(fileName != nullptr && *fileName != '\0');
        WriteNetlistFile(target, CInterface::ToLanguage(language), fileName, append != 0);
    });
}

orn_hdl_status_t orn_hdl_model_write_text(orn_hdl_model_t model, orn_hdl_language_t language,
                                          char** text, size_t* length) {
    return Change(model, [&](Model& target) {
        Require(text != nullptr);
        TextMemOutStream out;
        WriteNetlistText(target, CInterface::ToLanguage(language), out);
        CInterface::HandOutCopy(out.GetValue().GetView(), text, length);
    });
}

orn_hdl_status_t orn_hdl_model_write_commands(orn_hdl_model_t model, const char* fileName) {
    return Change(model, [&](const Model& target) {
        Require(fileName != nullptr && *fileName != '\0');
        if (!target.WriteCommands(fileName)) {
            throw CallFailure{ORN_HDL_FILE, std::string("cannot write ").append(fileName)};
        }
    });
}

orn_hdl_status_t orn_hdl_model_write_commands_text(orn_hdl_model_t model, char** text,
                                                   size_t* length) {
    return Change(model, [&](const Model& target) {
        Require(text != nullptr);
        TextMemOutStream out;
        target.WriteCommands(out);
        CInterface::HandOutCopy(out.GetValue().GetView(), text, length);
    });
}

orn_hdl_status_t orn_hdl_model_get_legal_name(orn_hdl_model_t model, orn_hdl_object_t object,
                                              orn_hdl_text_t* name) {
    return CInterface::Call<CInterface::ModelEntity>(model.id, [&](auto& entity) {
        Require(name != nullptr);
        CInterface::ResolvedObject resolved;
        const orn_hdl_status_t status = CInterface::Resolve(object, resolved);
        if (status != ORN_HDL_OK) {
            CInterface::End(status);
        }
        Require(resolved.entity == &entity);
        const CInterface::Changing changing(entity);
        CInterface::HandOutText(*name, NameInLegalNetlist(entity.model, *resolved.object));
    });
}

} // extern "C"
