// The functions of the C interface for readers of netlists.
#include "C/Calls.h"
#include "C/Texts.h"

#include <functional>

namespace CInterface = Orn_Hdl::CInterface;

using CInterface::Call;
using CInterface::End;
using CInterface::ModelEntity;
using CInterface::ReaderEntity;
using CInterface::Require;
using namespace Orn_Hdl;

namespace {

/// Marks a reader as being used.
class UsingReader {
public:
    explicit UsingReader(ReaderEntity& entity) : entity_(entity) {
        if (entity.isBusy) {
            End(ORN_HDL_BUSY);
        }
        entity.isBusy = true;
    }
    UsingReader(const UsingReader&) = delete;
    UsingReader& operator=(const UsingReader&) = delete;
    ~UsingReader() { entity_.isBusy = false; }

private:
    ReaderEntity& entity_;
};

/// Runs an action on the reader of either language.
template <class Action> orn_hdl_status_t WithReader(orn_hdl_reader_t reader, const Action& action) {
    return Call<ReaderEntity>(reader.id, [&](ReaderEntity& entity) {
        const UsingReader use(entity);
        if (entity.verilog != nullptr) {
            action(*entity.verilog);
        } else {
            action(*entity.vhdl);
        }
    });
}

/// Runs an action on a reader of Verilog.
template <class Action>
orn_hdl_status_t WithVerilogReader(orn_hdl_reader_t reader, const Action& action) {
    return Call<ReaderEntity>(reader.id, [&](ReaderEntity& entity) {
        const UsingReader use(entity);
        if (entity.verilog == nullptr) {
            End(ORN_HDL_WRONG_KIND);
        }
        action(*entity.verilog);
    });
}

const std::vector<ReaderRenaming>& RenamingsOf(const ReaderEntity& entity) noexcept {
    return entity.verilog != nullptr ? entity.verilog->GetRenamings() : entity.vhdl->GetRenamings();
}

std::string_view NameOf(ReaderRenaming::Kind kind) noexcept {
    switch (kind) {
    case ReaderRenaming::Kind::Module:
        return "Module";
    case ReaderRenaming::Kind::Component:
        return "Component";
    case ReaderRenaming::Kind::Pin:
        return "Pin";
    case ReaderRenaming::Kind::Instance:
        return "Instance";
    default:
        return "Signal";
    }
}

template <class Reader> void SetCommonSwitch(Reader& reader, orn_hdl_switch_t which, bool isOn) {
    switch (which) {
    case ORN_HDL_KEEP_ATTRIBUTES:
        reader.KeepAttributes(isOn);
        break;
    case ORN_HDL_KEEP_COMMENTS:
        reader.KeepComments(isOn);
        break;
    case ORN_HDL_KEEP_DONT_CARES:
        reader.KeepDontCares(isOn);
        break;
    case ORN_HDL_LITERAL_NAMES:
        reader.SetNames(isOn ? ReaderNames::Literal : ReaderNames::Simple);
        break;
    default:
        End(ORN_HDL_INVALID_ARGUMENT);
    }
}

} // namespace

extern "C" {

orn_hdl_status_t orn_hdl_reader_create(orn_hdl_language_t language, orn_hdl_reader_t* reader) {
    return CInterface::Attempt(nullptr, [&] {
        Require(reader != nullptr);
        auto entity = std::make_unique<ReaderEntity>();
        if (CInterface::ToLanguage(language) == Language::Verilog) {
            entity->verilog = std::make_unique<VerilogReader>();
        } else {
            entity->vhdl = std::make_unique<VhdlReader>();
        }
        // The handle leads to the entity, which the destroying call deletes.
        reader->id = entity.release()->GetId();
    });
}

orn_hdl_status_t orn_hdl_reader_destroy(orn_hdl_reader_t reader) {
    ReaderEntity* doomed = nullptr;
    const orn_hdl_status_t status = Call<ReaderEntity>(reader.id, [&](ReaderEntity& entity) {
        if (entity.isBusy) {
            End(ORN_HDL_BUSY);
        }
        doomed = &entity;
    });
    delete doomed;
    return status;
}

orn_hdl_status_t orn_hdl_reader_error(orn_hdl_reader_t reader, orn_hdl_error_t* error) {
    ReaderEntity* entity = nullptr;
    const orn_hdl_status_t status = CInterface::Resolve(reader.id, entity);
    return status != ORN_HDL_OK ? status : CInterface::TellError(entity->error, error);
}

orn_hdl_status_t orn_hdl_reader_set_top(orn_hdl_reader_t reader, const char* name) {
    return WithReader(reader, [&](auto& target) { target.SetTop(name); });
}

orn_hdl_status_t orn_hdl_reader_add_library(orn_hdl_reader_t reader, const char* fileName) {
    return WithReader(reader, [&](auto& target) {
        Require(fileName != nullptr);
        target.AddLibrary(fileName);
    });
}

orn_hdl_status_t orn_hdl_reader_add_library_model(orn_hdl_reader_t reader, orn_hdl_model_t model) {
    return WithReader(reader, [&](auto& target) {
        ModelEntity* entity = nullptr;
        const orn_hdl_status_t status = CInterface::Resolve(model.id, entity);
        if (status != ORN_HDL_OK) {
            End(status);
        }
        target.AddLibrary(*entity->model.GetNetlist());
    });
}

orn_hdl_status_t orn_hdl_reader_add_include_folder(orn_hdl_reader_t reader, const char* folder) {
    return WithVerilogReader(reader, [&](VerilogReader& target) {
        Require(folder != nullptr);
        target.AddIncludeFolder(folder);
    });
}

orn_hdl_status_t orn_hdl_reader_define(orn_hdl_reader_t reader, const char* name,
                                       const char* text) {
    return WithVerilogReader(reader, [&](VerilogReader& target) {
        Require(name != nullptr);
        target.Define(name, text == nullptr ? "" : text);
    });
}

orn_hdl_status_t orn_hdl_reader_set(orn_hdl_reader_t reader, orn_hdl_switch_t which, int on) {
    const bool isOn = on != 0;
    switch (which) {
    case ORN_HDL_KEEP_INCLUDES:
        return WithVerilogReader(reader, [&](VerilogReader& target) {
            target.SetIncludes(isOn ? VerilogReader::Includes::Keep
                                    : VerilogReader::Includes::Follow);
        });
    case ORN_HDL_INFER_UNDECLARED:
        return WithVerilogReader(reader, [&](VerilogReader& target) {
            target.SetUndeclared(isOn ? ReaderUndeclared::Infer : ReaderUndeclared::Refuse);
        });
    default:
        return WithReader(reader, [&](auto& target) { SetCommonSwitch(target, which, isOn); });
    }
}

orn_hdl_status_t orn_hdl_reader_set_kept_names(orn_hdl_reader_t reader, orn_hdl_keeps_t keeps,
                                               void* user) {
    return WithReader(reader, [&](auto& target) {
        std::function<bool(std::string_view)> function;
        if (keeps != nullptr) {
            function = [keeps, user](std::string_view name) {
                return keeps(user, std::string(name).c_str()) != 0;
            };
        }
        target.SetKeptNames(std::move(function));
    });
}

orn_hdl_status_t orn_hdl_reader_read(orn_hdl_reader_t reader, const char* fileName,
                                     orn_hdl_model_t model) {
    return WithReader(reader, [&](auto& target) {
        Require(fileName != nullptr);
        ModelEntity* entity = nullptr;
        const orn_hdl_status_t status = CInterface::Resolve(model.id, entity);
        if (status != ORN_HDL_OK) {
            End(status);
        }
        const CInterface::Changing changing(*entity);
        target.Read(fileName, entity->model);
    });
}

orn_hdl_status_t orn_hdl_reader_get_renaming(orn_hdl_reader_t reader, size_t index,
                                             orn_hdl_renaming_t* renaming) {
    return CInterface::Look<ReaderEntity>(reader.id, [&](const ReaderEntity& entity) {
        Require(renaming != nullptr);
        const std::vector<ReaderRenaming>& renamings = RenamingsOf(entity);
        if (index >= renamings.size()) {
            End(ORN_HDL_END);
        }
        const ReaderRenaming& found = renamings[index];
        CInterface::Texts texts;
        texts.Put(renaming->name, found.name);
        texts.Put(renaming->newName, found.newName);
        texts.Put(renaming->kind, NameOf(found.kind));
        texts.Put(renaming->component, found.component);
        texts.HandOut();
    });
}

} // extern "C"
