/// \file
/// `Proof`: a written netlist, read back and compared with its design.
#pragma once

#include "Orn_Hdl/Check.h"
#include "Orn_Hdl/Exception.h"
#include "Orn_Hdl/Language.h"
#include "Port/Export.h"
#include "Port/TextArgument.h"

#include <cstddef>
#include <cstdint>
#include <functional>
#include <string>
#include <vector>

namespace Orn_Hdl {

class Netlist;
class OutStream;
class TextFileOutStream;
struct HdlOptions;

/// Reads a netlist that was written and compares it with the design: the module, its ports and
/// their order, the signals, every instance with its component and each bit of its connections,
/// constants, aliases, parameters, and the attributes of the dialect in use. What the text has to
/// mean is told by the design alone; nothing of the writers is used, and the reader shares nothing
/// with them. Comments are not compared.
///
/// \code
/// for (const Proof::Difference& difference :
///      Proof::Compare("top.v", Language::Verilog, *model.GetNetlist(), *model.GetOptions())) {
///     std::cerr << "top.v:" << difference.line << ": " << difference.message << "\n";
/// }
/// \endcode
class ORN_HDL_API Proof {
public:
    /// Where a netlist does not say what the design does.
    struct Difference {
        /// What differs, in one line without a full stop.
        std::string message;
        /// The line in the netlist, from 1; 0 for none.
        std::uint64_t line = 0;
        /// The column in the line, from 1; 0 for none.
        std::uint64_t column = 0;
        /// The text of the line; empty for none.
        std::string source;
        /// The command that brought the object into the design.
        Check::Cause cause;
        /// The rule of `Check` that tells of this object; null for none.
        const Check::Rule* rule = nullptr;
    };

    /// How many differences are looked for.
    static constexpr std::size_t MostDifferences = 10;

    /// Compares a netlist with a design that was written before. The design is not changed.
    /// \param fileName the netlist, which is read twice.
    /// \param netlist the design as the write left it: sorted, with its dummy signals.
    /// \param options those of the write.
    /// \return the first differences; empty when the netlist means what the design does. What
    ///         cannot be read is a difference, too.
    /// \throws Exception when the file cannot be opened or read.
    static std::vector<Difference> Compare(const Port::TextArgument& fileName, Language language,
                                           const Netlist& netlist, const HdlOptions& options);
    /// Requires that a netlist means what a design does.
    /// \param fileName the file to read, such as a temporary one.
    /// \param shownName the name in the exception's text.
    /// \throws ProofException if there are differences, and Exception if the file cannot be read.
    static void Require(const Port::TextArgument& fileName, const Port::TextArgument& shownName,
                        Language language, const Netlist& netlist, const HdlOptions& options);

    /// A design as a write left it, and the options of the write. Both must outlive this object.
    struct Written {
        /// The design.
        const Netlist& netlist;
        /// The options of the write.
        const HdlOptions& options;
    };
    /// Writes a netlist that is proven before anything of it reaches a file that exists. A stream
    /// that does not replace its file gets the text by way of a temporary file. Closing the stream
    /// is left to the caller, as are the stream's errors.
    /// \param shownName the name in an exception's text.
    /// \param write writes the netlist.
    /// \param getWritten tells, after that, what was written.
    /// \throws ProofException if there are differences; the stream must then be destroyed without
    ///         closing it.
    static void Write(TextFileOutStream& out, const Port::TextArgument& shownName,
                      Language language, const std::function<void(OutStream&)>& write,
                      const std::function<Written()>& getWritten);
};

/// Says that a netlist does not mean what its design does. The text names the file and tells of
/// each difference.
class ORN_HDL_API ProofException : public Exception {
public:
    /// An exception with the differences between a file and its design.
    ProofException(const std::string& fileName, std::vector<Proof::Difference> differences);
    /// An independent copy.
    ProofException(const ProofException&);
    ~ProofException() override;

    /// What differs, at least one thing; valid as long as the exception is.
    const std::vector<Proof::Difference>& GetDifferences() const noexcept { return differences_; }

private:
    std::vector<Proof::Difference> differences_;
};

} // namespace Orn_Hdl
