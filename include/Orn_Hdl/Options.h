/// \file
/// `HdlOptions`, the output options of a model, and `HdlUtilities`, the helpers that both writers
/// share.
#pragma once

#include "Orn_Hdl/Containers/StringArray.h"
#include "Orn_Hdl/Language.h"
#include "Port/Export.h"
#include "Port/String.h"

namespace Orn_Hdl {

class Instance;
class OutStream;

/// The output options of one model.
struct ORN_HDL_API HdlOptions {
    /// The options of the VHDL writer.
    struct ORN_HDL_API VhdlOption {
        /// Omits the configuration.
        bool suppressConfiguration = false;
        /// Set by the command FLATTEN BUS; it has no effect on the output.
        bool flattenBus = false;
        /// Writes the library and use clauses for IEEE and KESTRA.
        bool useDefaultLibrary = true;
        /// Libraries that get a library clause.
        StringArray libraries;
        /// Names that get a use clause.
        StringArray useClauses;
        /// Gives attributes their own types instead of string.
        bool useAttrType = false;
        /// Leaves open input pins open; otherwise each is connected to a signal of its own.
        bool openPin = true;
        /// Omits the component declarations.
        bool suppressComponent = false;
    };

    /// The options of the Verilog writer.
    struct ORN_HDL_API VerilogOption {
        /// The tools in whose syntax synthesis attributes can be written.
        enum SynthesisType {
            QSN = 0,
            EXEMPLAR = 1,
            SYNPLICITY = 2,
            SYNOPSYS = 3,
            VERILOG2001 = 4,
            PRECISION = 5
        };
        /// How names are written. `DEFSULT`, which is spelt so, keeps them unchanged.
        enum CaseType { DEFSULT = 10, UPPERCASE = 11, LOWERCASE = 12 };

        /// The chosen tool, a `SynthesisType`.
        int synthesisType = QSN;
        /// How the names of signals are written.
        CaseType signalCase = DEFSULT;
        /// How the names of instances are written.
        CaseType instanceCase = DEFSULT;
        /// How the names of components are written.
        CaseType componentCase = DEFSULT;
        /// Files to include.
        StringArray includePaths;

        /// Selects the synthesis tool by its case-insensitive name; an unknown name selects QSN.
        void SetSynthesisType(const char* text);
        /// Whether the semicolon of a statement precedes its synthesis attributes.
        bool IsSemiColonWrittenBeforeAttr() const noexcept;
        /// The case type of a case-insensitive name; `DEFSULT` for an unknown name.
        static CaseType GetCaseType(const char* text);
    };

    /// The options of the VHDL writer.
    VhdlOption vhdl;
    /// The options of the Verilog writer.
    VerilogOption verilog;
    /// Whether files begin with the header.
    bool writeHeader = true;
    /// The program that the header names.
    Port::StringBase<char> application;
    /// The command line that the header shows.
    Port::StringBase<char> command;
    /// The device that the header names.
    Port::StringBase<char> device;
    /// The purpose that the header shows, as lines of words.
    Port::StringBase<char> purpose;
    /// The reference that the header shows, as lines of words.
    Port::StringBase<char> reference;
    /// Whether each port and each pin connection is written on a line of its own.
    bool onePortPerLine = true;
    /// Whether the last Verilog write passed the module's INIT parameter to instances instead of
    /// their own values. It is set by a write whose options are not constant, and never read.
    bool hierarchicalInit = false;
    /// Whether the writers write a legal netlist (`LegalNetlist`), or the design as it stands.
    bool legal = false;
    /// Whether a legal netlist escapes names where that is enough, instead of changing them.
    bool escapeNames = false;
    /// Whether the write commands read each netlist back and compare it with the design (`Proof`)
    /// before it replaces its file. A netlist that differs is an error, and the file stays.
    bool verify = false;
    /// Whether the digit "-" of a constant is a don't care: VHDL gets '-', and Verilog x. Otherwise
    /// the digits are written as they stand, and a constant of one bit is 0 or 1.
    bool dontCares = false;
    /// How many threads may write a netlist or read a command file together: 1 for the caller's
    /// alone, 0 for as many as the system gives, at most 8. What is written is the same, and small
    /// designs and files have one thread in any case. With more than one, the virtual functions of
    /// classes that a program has derived from those of the library are called by several threads
    /// at once while a netlist is written.
    unsigned threads = 1;
};

/// Helpers that both writers share.
class ORN_HDL_API HdlUtilities {
public:
    /// The present time as MM/DD/YYYY HH:MM:SS, or the instant of SOURCE_DATE_EPOCH in UTC.
    static const Port::StringBase<char> CurrentTimeString();
    /// The library's version.
    static const Port::StringBase<char> GetVersion();
    /// The base specifier of a VHDL bit string literal (IEEE 1076-1993, 13.7): "b" for 2, "o" for
    /// 8, else "x".
    static const Port::StringBase<char> ConvertVhdlBase(int base);
    /// The base letter of a Verilog sized constant (IEEE 1364, 2.5.1): "b" for 2, "o" for 8,
    /// else "h".
    static const Port::StringBase<char> ConvertVerilogBase(int base);
    /// Adds "_DUMMY" to a name, before its range if it has one: D(7:0) becomes D_DUMMY(7:0).
    static const Port::StringBase<char> AddDummySuffix(const char* name);
    /// Whether a name, range aside, has the form of the names that the library gives to dummy
    /// signals, to the signals of constants at pins, and to the signals at open pins. A design with
    /// such names of its own may get two signals of one name. Null is read as "".
    static bool IsGeneratedName(const char* name);
    /// Removes the quotes of a text that is entirely enclosed in double or in single quotes; null
    /// is read as "".
    static const Port::StringBase<char> RemoveQuotes(const char* text);
    /// The names of the attributes of an instance, then of those attributes of its component that
    /// the instance does not have. The list is empty if the instance is null.
    static const StringArray GetAttrNames(const Instance* instance);
    /// Writes the header banner in comments of a language.
    static void WriteHeader(const Port::StringBase<char>& designName, Language language,
                            const HdlOptions& options, OutStream& out);
    /// Writes the header banner in VHDL or Verilog comments.
    /// \param vhdlComments true for VHDL comments, false for Verilog's.
    static void WriteHeader(const Port::StringBase<char>& designName, bool vhdlComments,
                            const HdlOptions& options, OutStream& out);
};

} // namespace Orn_Hdl
