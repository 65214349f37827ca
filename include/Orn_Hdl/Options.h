/// \file
/// `HdlOptions`, what a model's option commands set and the writers read, and `HdlUtilities`, the
/// helpers that both writers share.
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
    /// What the VHDL writer reads.
    struct ORN_HDL_API VhdlOption {
        /// Leaves the configuration out.
        bool suppressConfiguration = false;
        /// What the command FLATTEN BUS sets; it has no effect on what is written.
        bool flattenBus = false;
        /// Writes the IEEE and KESTRA clauses.
        bool useDefaultLibrary = true;
        /// Library clauses to be added.
        StringArray libraries;
        /// Use clauses to be added.
        StringArray useClauses;
        /// Gives attributes their own types in place of string.
        bool useAttrType = false;
        /// Leaves open input pins open; otherwise they are tied to signals of their own.
        bool openPin = true;
        /// Leaves the component declarations out.
        bool suppressComponent = false;
    };

    /// What the Verilog writer reads.
    struct ORN_HDL_API VerilogOption {
        /// The tools whose syntax synthesis attributes can have.
        enum SynthesisType {
            QSN = 0,
            EXEMPLAR = 1,
            SYNPLICITY = 2,
            SYNOPSYS = 3,
            VERILOG2001 = 4,
            PRECISION = 5
        };
        /// How names are written. `DEFSULT` keeps them as they are; the spelling is the option's.
        enum CaseType { DEFSULT = 10, UPPERCASE = 11, LOWERCASE = 12 };

        /// The chosen tool, a `SynthesisType`.
        int synthesisType = QSN;
        /// How the names of signals are written.
        CaseType signalCase = DEFSULT;
        /// How the names of instances are written.
        CaseType instanceCase = DEFSULT;
        /// How the names of components are written.
        CaseType componentCase = DEFSULT;
        /// Files to be included.
        StringArray includePaths;

        /// Selects the synthesis tool by name, letter case ignored; an unknown name selects QSN.
        void SetSynthesisType(const char* text);
        /// Whether a statement's semicolon stands before its synthesis attributes.
        bool IsSemiColonWrittenBeforeAttr() const noexcept;
        /// The case of a name, letter case ignored; an unknown name gives `DEFSULT`.
        static CaseType GetCaseType(const char* text);
    };

    /// What the VHDL writer reads.
    VhdlOption vhdl;
    /// What the Verilog writer reads.
    VerilogOption verilog;
    /// Whether files begin with the header.
    bool writeHeader = true;
    /// The program that the header names.
    Port::StringBase<char> application;
    /// The command line that the header shows.
    Port::StringBase<char> command;
    /// The device that the header names.
    Port::StringBase<char> device;
    /// The purpose that the header gives, in lines of words.
    Port::StringBase<char> purpose;
    /// The reference that the header gives, in lines of words.
    Port::StringBase<char> reference;
    /// Whether each port and each pin connection stands on a line of its own.
    bool onePortPerLine = true;
    /// Whether the last Verilog write gave instances the module's own INIT parameter in place of
    /// values of their own. A write with options that it may change sets it; no write reads it.
    bool hierarchicalInit = false;
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
    /// Puts "_DUMMY" behind a name, or before its range: D(7:0) gives D_DUMMY(7:0).
    static const Port::StringBase<char> AddDummySuffix(const char* name);
    /// Whether a name, range aside, has the form of the names that the library gives to dummy
    /// signals, to the signals of constants at pins, and to the signals at open pins. A design with
    /// such names of its own may get two signals of one name. Null is read as "".
    static bool IsGeneratedName(const char* name);
    /// Takes the quotes off a text that is wholly enclosed in double or in single quotes; null is
    /// read as "".
    static const Port::StringBase<char> RemoveQuotes(const char* text);
    /// The names of an instance's attributes, then those of its component's that it does not have.
    /// A null instance gives an empty list.
    static const StringArray GetAttrNames(const Instance* instance);
    /// Writes the header banner in comments of a language.
    static void WriteHeader(const Port::StringBase<char>& designName, Language language,
                            const HdlOptions& options, OutStream& out);
    /// Writes the header banner in the comments that a flag chooses.
    /// \param vhdlComments true for VHDL comments, false for Verilog's.
    static void WriteHeader(const Port::StringBase<char>& designName, bool vhdlComments,
                            const HdlOptions& options, OutStream& out);
};

} // namespace Orn_Hdl
