// Reads the headers of Verilog modules.

#include "cells/CellDeclaration.h"
#include "cells/VerilogLexer.h"
#include "cells/VerilogNumber.h"

#include <cstdlib>
#include <optional>
#include <unordered_map>
#include <utility>

namespace Tool::Cells {

namespace {

bool IsDirection(const VerilogToken& token) noexcept {
    return token.Is("input") || token.Is("output") || token.Is("inout");
}

PortDirection GetDirection(const VerilogToken& token) noexcept {
    return token.Is("input")    ? PortDirection::Input
           : token.Is("output") ? PortDirection::Output
                                : PortDirection::InOut;
}

/// What stands before the name in a declaration, and applies to the names behind the next comma.
struct PortType {
    PortDirection direction = PortDirection::Unknown;
    CellPort::Width width = CellPort::Scalar;
    PortRange range;
};

class VerilogReader {
public:
    explicit VerilogReader(std::string_view text) : lexer_(text) { Step(); }

    std::vector<CellDeclaration> Read();

private:
    void Step() { token_ = lexer_.Next(); }
    [[noreturn]] void Fail(const std::string& text) const { throw Error(token_.line, text); }
    void Expect(std::string_view mark);
    /// Goes behind a word. \param start the word that it ends.
    void SkipBehind(std::string_view end, std::string_view start);
    void SkipParentheses();

    void ReadModule();
    void ReadParameterList();
    void ReadPortList();
    void ReadDeclaredPort(PortType& type);
    void ReadListedPort();
    void ReadBody();
    void ReadPortDeclaration();
    /// Reads one parameter, to the "," or the end behind it.
    void ReadParameter(std::optional<std::int64_t>& width);
    void SetDefault(CellParameter& parameter, const std::vector<VerilogToken>& value,
                    std::optional<std::int64_t> width);
    void ReadRange(PortType& type);
    std::optional<std::int64_t> ReadBound(std::string_view end);
    bool IsAtItemEnd() const noexcept {
        return token_.Is(",") || token_.Is(")") || token_.Is(";") || token_.kind == token_.End;
    }
    void SkipItem();
    CellPort& GetOrAddPort(std::string_view name);

    VerilogLexer lexer_;
    VerilogToken token_;
    std::vector<CellDeclaration> cells_;
    /// The module that is read, and its ports by name.
    CellDeclaration cell_;
    std::unordered_map<std::string_view, std::size_t> ports_;
};

void VerilogReader::Expect(std::string_view mark) {
    if (!token_.Is(mark)) {
        Fail("\"" + std::string(mark) + "\" is expected");
    }
    Step();
}

void VerilogReader::SkipBehind(std::string_view end, std::string_view start) {
    const std::size_t line = token_.line;
    while (!token_.Is(end)) {
        if (token_.kind == VerilogToken::End) {
            throw Error(line,
                        "\"" + std::string(end) + "\" is missing for this " + std::string(start));
        }
        Step();
    }
    Step();
}

std::vector<CellDeclaration> VerilogReader::Read() {
    while (token_.kind != VerilogToken::End) {
        if (token_.Is("module") || token_.Is("macromodule")) {
            ReadModule();
        } else if (token_.Is("primitive")) {
            SkipBehind("endprimitive", "primitive");
        } else {
            Step();
        }
    }
    return std::move(cells_);
}

void VerilogReader::ReadModule() {
    cell_ = CellDeclaration();
    ports_.clear();
    Step();
    if (token_.Is("automatic") || token_.Is("static")) {
        Step();
    }
    if (!token_.IsName() || token_.text.empty()) {
        Fail("the name of a module is expected");
    }
    cell_.name = token_.text;
    Step();
    while (token_.Is("import")) {
        SkipBehind(";", "import");
    }
    if (token_.Is("#")) {
        Step();
        ReadParameterList();
    }
    if (token_.Is("(")) {
        ReadPortList();
    }
    Expect(";");
    ReadBody();
    cells_.push_back(std::move(cell_));
}

void VerilogReader::ReadParameterList() {
    Expect("(");
    std::optional<std::int64_t> width;
    while (!token_.Is(")")) {
        if (token_.kind == VerilogToken::End || token_.Is(";")) {
            Fail("\")\" is expected");
        }
        ReadParameter(width);
        if (token_.Is(",")) {
            Step();
        }
    }
    Step();
}

void VerilogReader::ReadParameter(std::optional<std::int64_t>& width) {
    bool isLocal = false;
    bool hasType = false;
    if (token_.Is("parameter") || token_.Is("localparam")) {
        isLocal = token_.Is("localparam");
        width.reset();
        Step();
    }
    PortType type;
    VerilogToken name;
    while (!token_.Is("=") && !IsAtItemEnd()) {
        if (token_.Is("[")) {
            ReadRange(type);
            hasType = true;
            continue;
        }
        if (token_.Is("(")) {
            SkipParentheses();
            continue;
        }
        if (token_.IsName()) {
            name = token_;
        }
        Step();
    }
    if (hasType) {
        width = type.width == CellPort::Bus
                    ? std::optional(std::abs(type.range.left - type.range.right) + 1)
                    : std::nullopt;
    }
    if (!name.IsName() || name.text.empty()) {
        Fail("the name of a parameter is expected");
    }
    std::vector<VerilogToken> value;
    if (token_.Is("=")) {
        Step();
        std::size_t depth = 0;
        while (token_.kind != VerilogToken::End && (depth > 0 || !IsAtItemEnd())) {
            if (token_.Is("(") || token_.Is("{") || token_.Is("[")) {
                ++depth;
            } else if (token_.Is(")") || token_.Is("}") || token_.Is("]")) {
                depth -= depth > 0 ? 1 : 0;
            }
            // More tokens than a literal with a sign has are an expression.
            if (value.size() < 3) {
                value.push_back(token_);
            }
            Step();
        }
    }
    if (isLocal) {
        return;
    }
    CellParameter& parameter = cell_.parameters.emplace_back();
    parameter.name = name.text;
    SetDefault(parameter, value, width);
}

void VerilogReader::SetDefault(CellParameter& parameter, const std::vector<VerilogToken>& value,
                               std::optional<std::int64_t> width) {
    const bool isNegative = value.size() == 2 && value.front().Is("-");
    if (value.size() != (isNegative ? 2 : 1)) {
        return;
    }
    const VerilogToken& literal = value.back();
    if (literal.kind == VerilogToken::Text && !isNegative) {
        // What an escape stands for is not known here.
        if (literal.text.find('\\') == std::string_view::npos) {
            parameter.kind = CellParameter::Text;
            parameter.text = literal.text;
        }
    } else if (literal.kind == VerilogToken::Number) {
        SetNumber(parameter, literal.text, isNegative, width);
    }
}

void VerilogReader::ReadPortList() {
    Step();
    PortType type;
    bool isDeclared = false;
    while (!token_.Is(")")) {
        if (token_.kind == VerilogToken::End || token_.Is(";")) {
            Fail("\")\" is expected");
        }
        isDeclared = isDeclared || IsDirection(token_);
        if (isDeclared) {
            ReadDeclaredPort(type);
        } else {
            ReadListedPort();
        }
        if (token_.Is(",")) {
            Step();
        }
    }
    Step();
}

/// A port of a list, or of a declaration, to the "," or the end behind it.
/// \param type what the port before it has, which holds unless the port has its own.
void VerilogReader::ReadDeclaredPort(PortType& type) {
    if (IsDirection(token_)) {
        type = PortType{GetDirection(token_), CellPort::Scalar, {}};
        Step();
    }
    PortType own;
    bool hasType = false;
    VerilogToken name;
    while (!IsAtItemEnd() && !token_.Is("=")) {
        if (token_.Is("[")) {
            const bool isUnpacked = name.IsName() && hasType;
            ReadRange(own);
            own.width = isUnpacked ? CellPort::Unknown : own.width;
            hasType = true;
            continue;
        }
        if (token_.IsName()) {
            name = token_;
        }
        Step();
    }
    if (hasType) {
        type.width = own.width;
        type.range = own.range;
    }
    SkipItem();
    if (!name.IsName() || name.text.empty()) {
        Fail("the name of a port is expected");
    }
    CellPort& port = GetOrAddPort(name.text);
    port.direction = type.direction;
    port.width = type.width;
    port.range = type.range;
}

/// A port that is declared in the body of the module.
void VerilogReader::ReadListedPort() {
    // Yosys writes three periods for a list that the body gives.
    while (token_.Is(".")) {
        Step();
    }
    if (token_.IsName() && !token_.text.empty()) {
        GetOrAddPort(token_.text);
        Step();
    } else if (!IsAtItemEnd() && !token_.Is("{")) {
        Fail("the name of a port is expected");
    }
    SkipItem();
}

void VerilogReader::ReadBody() {
    while (!token_.Is("endmodule")) {
        if (token_.kind == VerilogToken::End) {
            Fail("\"endmodule\" is missing for module " + cell_.name);
        } else if (IsDirection(token_)) {
            ReadPortDeclaration();
        } else if (token_.Is("parameter")) {
            std::optional<std::int64_t> width;
            do {
                ReadParameter(width);
            } while (token_.Is(",") && (Step(), true));
        } else if (token_.Is("function")) {
            SkipBehind("endfunction", "function");
        } else if (token_.Is("task")) {
            SkipBehind("endtask", "task");
        } else if (token_.Is("specify")) {
            SkipBehind("endspecify", "specify");
        } else {
            Step();
        }
    }
    Step();
}

void VerilogReader::ReadPortDeclaration() {
    PortType type;
    do {
        ReadDeclaredPort(type);
    } while (token_.Is(",") && (Step(), true));
}

void VerilogReader::ReadRange(PortType& type) {
    const bool isSecond = type.width != CellPort::Scalar;
    Expect("[");
    const std::optional<std::int64_t> left = ReadBound(":");
    std::optional<std::int64_t> right;
    if (token_.Is(":")) {
        Step();
        right = ReadBound("]");
    }
    if (!token_.Is("]")) {
        Fail("\"]\" is expected");
    }
    Step();
    type.width = CellPort::Unknown;
    if (left && right && !isSecond) {
        CellPort port;
        SetRange(port, PortRange{*left, *right});
        type.width = port.width;
        type.range = port.range;
    }
}

/// The value of one side of a range, if it is a number; goes to the ":" or "]" behind it.
std::optional<std::int64_t> VerilogReader::ReadBound(std::string_view end) {
    ConstantSum sum;
    std::size_t depth = 0;
    while (depth > 0 || (!token_.Is(end) && !token_.Is("]"))) {
        if (token_.kind == VerilogToken::End || token_.Is(";")) {
            Fail("\"]\" is expected");
        }
        if (token_.Is("(") || token_.Is("[") || token_.Is("{")) {
            ++depth;
        } else if (token_.Is(")") || token_.Is("]") || token_.Is("}")) {
            depth -= depth > 0 ? 1 : 0;
        }
        sum.Add(token_.text);
        Step();
    }
    return sum.Get();
}

void VerilogReader::SkipParentheses() {
    std::size_t depth = 0;
    do {
        if (token_.kind == VerilogToken::End) {
            Fail("\")\" is expected");
        }
        depth += token_.Is("(") ? 1 : 0;
        depth -= token_.Is(")") ? 1 : 0;
        Step();
    } while (depth > 0);
}

/// Goes to the "," or the end behind an item.
void VerilogReader::SkipItem() {
    std::size_t depth = 0;
    while (token_.kind != VerilogToken::End && (depth > 0 || !IsAtItemEnd())) {
        if (token_.Is("(") || token_.Is("{") || token_.Is("[")) {
            ++depth;
        } else if (token_.Is(")") || token_.Is("}") || token_.Is("]")) {
            depth -= depth > 0 ? 1 : 0;
        }
        Step();
    }
}

CellPort& VerilogReader::GetOrAddPort(std::string_view name) {
    const auto [place, isNew] = ports_.try_emplace(name, cell_.ports.size());
    if (isNew) {
        cell_.ports.emplace_back().name = name;
    }
    return cell_.ports[place->second];
}

} // namespace

std::vector<CellDeclaration> ReadVerilogCells(std::string_view text) {
    return VerilogReader(text).Read();
}

} // namespace Tool::Cells
