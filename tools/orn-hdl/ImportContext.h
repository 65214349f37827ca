// What all parts of one import share: the design, the choices of the user, and what to tell them.
#pragma once

#include "ImportDesign.h"
#include "ImportSink.h"

#include <cstddef>
#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

namespace Tool::Import {

/// A place in a module that becomes a `Path` only when there is something to tell of it.
struct Place {
    std::string_view module;
    std::string_view table;
    std::string_view object;
    std::string_view part;
    std::string_view name;

    Path ToPath() const;
};

class Context {
public:
    /// \param top a module of the design.
    /// \param unknownAs what x and z become, `Zero` or `One`; without it they are refused.
    Context(const Module& top, std::optional<Bit> unknownAs) : top_(top), unknownAs_(unknownAs) {}

    const Module& GetTop() const noexcept { return top_; }
    Bit GetBit(const Span& bits, std::uint32_t i) const { return top_.bits[bits.start + i]; }

    /// A place in the top module, such as one of its "cells".
    Path GetPath(std::string_view table, std::string_view name) const;
    Path GetPinPath(const Cell& cell, std::string_view pin) const;
    Place GetPlace(const Cell& cell, std::string_view part, std::string_view name) const noexcept {
        return Place{top_.name, "cells", cell.name, part, name};
    }

    /// What a bit stands for that drives something: itself, or what the user chose for x and z.
    Bit Settle(Bit bit) const noexcept { return bit >= Unknown && unknownAs_ ? *unknownAs_ : bit; }
    bool IsRefused(Bit bit) const noexcept { return bit >= Unknown && !unknownAs_; }
    [[noreturn]] static void Refuse(Bit bit, const Path& path);
    /// Refuses a parameter's value that holds an x or z which stands for nothing; tells of a text
    /// that cannot be written as one.
    void CheckParameter(const Value& value, const Place& place);
    /// A parameter's value as a generic.
    TypedValue MakeGeneric(const std::string& name, const Value& value) const;
    /// Tells of a text that cannot be written as it is.
    void CheckAttribute(const Value& value, const Place& place);
    static TypedValue MakeAttribute(const std::string& name, const Value& value);

    /// Tells the user something. What is told of many places is told once.
    void Warn(const Path& path, std::string_view text);
    std::vector<std::string> GetWarnings() const;

private:
    const Module& top_;
    const std::optional<Bit> unknownAs_;
    struct Warning {
        std::string path;
        std::string text;
        std::size_t count = 0;
    };
    std::vector<Warning> warnings_;
    std::unordered_map<std::string, std::size_t> warningIndex_;
};

/// Stops the import: the file says something at `path` that cannot be imported.
[[noreturn]] void Fail(const Path& path, std::string_view text);

/// A range whose indices both languages can hold: one that begins below 0, or reaches beyond 32
/// bits, is moved to begin at 0.
Range Normalize(Range range, std::uint32_t width) noexcept;
/// The index of a bit of a bus, counted from its rightmost one.
std::int64_t GetIndex(Range range, std::uint32_t width, std::uint32_t position) noexcept;

std::string MakeBitName(std::string_view base, std::int64_t index);
std::string MakeBusName(std::string_view base, std::int64_t left, std::int64_t right);

/// A constant as the command language spells it: a bare digit for one bit without a range.
std::string MakeConstant(const std::string& digits, bool scalar);

} // namespace Tool::Import
