// The memory destination: the text unchanged, without indentation or line breaks.
#pragma once

#include "Orn_Hdl/Streams.h"
#include "Port/Ascii.h"
#include "Streams/BranchDst.h"

#include <memory>
#include <string>
#include <string_view>

namespace Orn_Hdl {

class TextMemDst final : public StreamDst {
public:
    explicit TextMemDst(std::string_view initial) : text_(initial) {}

    const std::string& GetText() const noexcept { return text_; }
    void SetText(std::string_view text) { text_ = text; }

    void Write(const char* text) override { text_ += Port::ViewOf(text); }
    void Write(int number) override { text_ += std::to_string(number); }
    void WriteView(std::string_view text) override { text_ += text; }

private:
    std::unique_ptr<BranchDst> MakeBranch() const override {
        return std::make_unique<PlainBranchDst>(GetIndentLevel());
    }
    bool TakeLines(std::string_view lines) override {
        text_ += lines;
        return true;
    }

    std::string text_;
};

} // namespace Orn_Hdl
