/// \file
/// `LegalNetlist`: a design written so that every tool takes it.
#pragma once

#include "Orn_Hdl/Check.h"
#include "Orn_Hdl/Language.h"
#include "Port/Export.h"

#include <memory>
#include <string>
#include <vector>

namespace Orn_Hdl {

class Netlist;
class Object;
class OutStream;
struct HdlOptions;

/// Writes a design so that the tools of `Check` take it without an error and both languages mean
/// the same. What `Check` finds no error in is written as it stands. Otherwise a private copy is
/// written, in which names, constants and whatever else is at fault are others; the design itself
/// stays as it is. Both languages get the same names.
///
/// \code
/// LegalNetlist legal(*model.GetNetlist(), *model.GetOptions());
/// for (const Check::Finding& finding : legal.GetErrors()) {
///     std::cerr << finding.message << "\n";
/// }
/// \endcode
class ORN_HDL_API LegalNetlist {
public:
    /// Checks the design and decides what to change.
    /// \param netlist must outlive this object, and must not change before it is written.
    /// \param options must outlive this object.
    LegalNetlist(Netlist& netlist, const HdlOptions& options);
    LegalNetlist(const LegalNetlist&) = delete;
    LegalNetlist& operator=(const LegalNetlist&) = delete;
    /// The design stays as it is.
    ~LegalNetlist();

    /// What no netlist can mend, such as two drivers of one net. If there is anything, nothing can
    /// be written.
    const std::vector<Check::Finding>& GetErrors() const noexcept;
    /// Whether the design is written as it stands.
    bool IsUnchanged() const noexcept;
    /// The name under which the netlist, a component, an instance, a scalar signal, a bus or a pin
    /// of a component is written, without range and without the marks of an escaped name.
    std::string GetName(const Object& object) const;

    /// Makes what `Write` writes in a language, so that nothing but the stream can fail then.
    /// \throws Exception with the text of every error when there are any.
    void Prepare(Language language);
    /// Writes the netlist. Writing a design that is written as it stands changes it as the
    /// netlisters do: it is sorted, and dummy signals are made.
    /// \throws Exception, nothing written, with the text of every error when there are any.
    void Write(Language language, OutStream& out);
    /// The design that was written last, as the write left it: the copy, or the design itself. The
    /// options' `verify` keeps the copy; it is valid until this object changes.
    const Netlist& GetWrittenNetlist() const noexcept;
    /// The options that were in force for it.
    const HdlOptions& GetWrittenOptions() const noexcept;

private:
    struct Implementation;

    std::unique_ptr<Implementation> implementation_;
};

} // namespace Orn_Hdl
