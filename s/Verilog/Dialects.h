// The synthesis dialects: how the attributes of an object are written in Verilog for each tool.
// Look-up, help and the writer read the table in this file.
#pragma once

#include "Orn_Hdl/Options.h"
#include "Orn_Hdl/Writers/Verilog.h"

#include <cstddef>
#include <iterator>
#include <string_view>
#include <type_traits>

namespace Orn_Hdl {

/// One dialect.
struct Dialect {
    HdlOptions::VerilogOption::SynthesisType type;
    /// The argument of the command SET SYNTHESIS.
    std::string_view name;
    /// Whether the attributes follow the semicolon of their object's statement.
    bool isSemicolonFirst;
    /// Writes the attributes of the object of that name.
    void (*write)(VerilogStatements& statements, const Iterator<Attribute*>& attributes,
                  const char* objectName);
};

/// Calls a function of `VerilogStatements`, which need not have a parameter for the object's name.
template <auto Function>
void WriteAttributes(VerilogStatements& statements, const Iterator<Attribute*>& attributes,
                     const char* objectName) {
    if constexpr (std::is_invocable_v<decltype(Function), VerilogStatements&,
                                      const Iterator<Attribute*>&, const char*>) {
        (statements.*Function)(attributes, objectName);
    } else {
        (statements.*Function)(attributes);
    }
}

/// Writes no attributes.
inline void WriteNoAttributes(VerilogStatements&, const Iterator<Attribute*>&, const char*) {}

/// A row for each value of `SynthesisType`, in their order. The first one is the default.
inline constexpr Dialect Dialects[] = {
    {HdlOptions::VerilogOption::QSN, "QSN", true,
     WriteAttributes<&VerilogStatements::WriteQSNAttr>},
    {HdlOptions::VerilogOption::EXEMPLAR, "EXEMPLAR", true,
     WriteAttributes<&VerilogStatements::WriteExemplarAttr>},
    {HdlOptions::VerilogOption::SYNPLICITY, "SYNPLICITY", false,
     WriteAttributes<&VerilogStatements::WriteSynplicityAttr>},
    {HdlOptions::VerilogOption::SYNOPSYS, "SYNOPSYS", true,
     WriteAttributes<&VerilogStatements::WriteSynopsysAttr>},
    {HdlOptions::VerilogOption::VERILOG2001, "VERILOG2001", true, WriteNoAttributes},
    {HdlOptions::VerilogOption::PRECISION, "PRECISION", true,
     WriteAttributes<&VerilogStatements::WritePrecisionAttr>},
};

/// The dialect of a `SynthesisType`; for any other number the default.
constexpr const Dialect& DialectOf(int synthesisType) {
    for (const Dialect& dialect : Dialects) {
        if (dialect.type == synthesisType) {
            return dialect;
        }
    }
    return *Dialects;
}

/// A sentence with the names of all dialects, "A, B or C", composed at compile time.
class DialectSentence {
public:
    constexpr DialectSentence(std::string_view before, std::string_view after) {
        Add(before);
        for (std::size_t i = 0; i < std::size(Dialects); ++i) {
            Add(i == 0 ? "" : i + 1 == std::size(Dialects) ? " or " : ", ");
            Add(Dialects[i].name);
        }
        Add(after);
    }

    constexpr const char* GetText() const noexcept { return text_; }

private:
    /// A sentence that is too long does not compile.
    constexpr void Add(std::string_view piece) {
        for (const char c : piece) {
            text_[size_++] = c;
        }
    }

    char text_[256] = {};
    std::size_t size_ = 0;
};

} // namespace Orn_Hdl
