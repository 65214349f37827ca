#include "NetlistText.h"

#include "Orn_Hdl/Orn_Hdl.h"

#include <array>
#include <cerrno>
#include <string_view>

namespace Tool {

void WriteNetlist(Orn_Hdl::Model& model, Orn_Hdl::LegalNetlist* legal, Orn_Hdl::Language language,
                  Orn_Hdl::OutStream& out) {
    if (legal != nullptr) {
        legal->Write(language, out);
        return;
    }
    switch (language) {
    case Orn_Hdl::Language::Verilog:
        Orn_Hdl::VerilogNetlister(out).WriteNetlist(model.GetNetlist(), *model.GetOptions());
        break;
    case Orn_Hdl::Language::Vhdl:
        Orn_Hdl::VhdlNetlister(out).WriteNetlist(model.GetNetlist(), model.GetOptions());
        break;
    }
}

Orn_Hdl::Proof::Written GetWritten(Orn_Hdl::Model& model, const Orn_Hdl::LegalNetlist* legal) {
    return legal != nullptr
               ? Orn_Hdl::Proof::Written{legal->GetWrittenNetlist(), legal->GetWrittenOptions()}
               : Orn_Hdl::Proof::Written{*model.GetNetlist(), *model.GetOptions()};
}

TemporaryFile::TemporaryFile() : file_(std::tmpfile(), &std::fclose) {
    if (file_ == nullptr) {
        ComplainUnwritable("a temporary file", errno);
    } else {
        name_ = "/dev/fd/" + std::to_string(fileno(file_.get()));
    }
}

Status TemporaryFile::Print() const {
    std::rewind(file_.get());
    std::array<char, 65536> piece;
    while (const std::size_t count = std::fread(piece.data(), 1, piece.size(), file_.get())) {
        if (const Status status = Tool::Print(std::string_view(piece.data(), count));
            status != Status::Success) {
            return status;
        }
    }
    return std::ferror(file_.get()) == 0 ? Status::Success
                                         : ComplainUnreadable("a temporary file", errno);
}

} // namespace Tool
