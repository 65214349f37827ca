#include "import/PartReader.h"

#include <algorithm>

namespace Tool::Import {

Direction PartReader::ReadDirection() {
    const std::string_view text = walker_.ReadText();
    if (text == "input") {
        return Direction::Input;
    }
    if (text == "output") {
        return Direction::Output;
    }
    if (text != "inout") {
        walker_.Fail("a direction is \"input\", \"output\" or \"inout\"");
    }
    return Direction::InOut;
}

bool PartReader::ReadRange(std::string_view key, BitRange& range) {
    if (key == "offset") {
        range.offset = walker_.ReadInteger();
    } else if (key == "upto") {
        range.upto = walker_.ReadFlag();
    } else {
        return false;
    }
    return true;
}

Bit PartReader::ReadBit() {
    if (walker_.IsNumber()) {
        const std::int64_t number = walker_.ReadInteger();
        if (number < 0) {
            walker_.Fail("the number of a net is negative");
        }
        return bitNumbers_.GetIndex(number, walker_.GetBytesRead());
    }
    const std::string_view text = walker_.ReadText();
    const std::size_t constant = std::string_view("01xz").find(text);
    if (text.size() != 1 || constant == std::string_view::npos) {
        walker_.Fail("a bit is a number or one of \"0\", \"1\", \"x\" and \"z\"");
    }
    return Zero + static_cast<Bit>(constant);
}

Span PartReader::ReadBits(Module& module) {
    const auto start = static_cast<std::uint32_t>(module.bits.size());
    walker_.ForEachElement([&] { module.bits.push_back(ReadBit()); });
    return Span{start, static_cast<std::uint32_t>(module.bits.size()) - start};
}

Value PartReader::ReadValue() {
    Value result;
    if (walker_.IsNumber()) {
        const std::int64_t number = walker_.ReadInteger();
        result.kind = Value::Integer;
        result.integer = static_cast<std::int32_t>(number);
        if (result.integer != number) {
            walker_.Fail("the number does not fit in 32 bits");
        }
        return result;
    }
    std::string_view text = walker_.ReadText();
    const std::size_t digits = std::min(text.find_first_not_of("01xz"), text.size());
    const std::size_t end = std::min(text.find_first_not_of(' ', digits), text.size());
    if (digits > 0 && digits == text.size()) {
        result.kind = Value::Bits;
    } else if (end == text.size() && end > digits) {
        text.remove_suffix(1);
    }
    result.text = design_.Keep(text);
    return result;
}

std::string_view PartReader::KeepOnce(std::string_view name) {
    std::string_view kept = names_.Get(name);
    if (kept.data() == nullptr) {
        names_.Add(name, [&](std::string_view text) { return kept = design_.Keep(text); });
    }
    return kept;
}

Span PartReader::ReadValues(Module& module) {
    const auto start = static_cast<std::uint32_t>(module.values.size());
    walker_.ForEachField([&](std::string_view name) {
        const std::string_view kept = KeepOnce(name);
        module.values.push_back(NamedValue{kept, ReadValue()});
    });
    return Span{start, static_cast<std::uint32_t>(module.values.size()) - start};
}

} // namespace Tool::Import
