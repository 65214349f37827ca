/// \file
/// `Check`, which tells of a design what standards and tools make of the netlists that the writers
/// would write.
#pragma once

#include "Port/Export.h"

#include <array>
#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

namespace Orn_Hdl {

class Netlist;
class Object;
struct HdlOptions;

/// Finds what is rejected, warned of, or read otherwise than meant in the netlists that the writers
/// would write of a design. It changes nothing, reads no file and prints nothing.
///
/// \code
/// for (const Check::Finding& finding : Check::Run(*model.GetNetlist(), *model.GetOptions())) {
///     if (finding.GetSeverity() == Check::Severity::Error) {
///         std::cerr << finding.message << "\n";
///     }
/// }
/// \endcode
class ORN_HDL_API Check {
public:
    /// The standards, and the tools in the versions that the documentation names.
    enum class Target {
        Verilog1995,
        Verilog2005,
        SystemVerilog2017,
        Vhdl93,
        Vhdl2008,
        Icarus,
        Verilator,
        Yosys,
        Ghdl
    };
    /// How many targets there are.
    static constexpr std::size_t TargetCount = 9;

    /// What a target makes of something, the worst last.
    enum class Verdict { Accepts, Warns, Misreads, Rejects };
    /// How bad a finding is. What is misread is an error, as is what is rejected.
    enum class Severity { Warning, Error };

    /// A set of targets.
    class ORN_HDL_API Targets {
    public:
        /// No target.
        constexpr Targets() noexcept = default;
        /// \{
        /// Every target; those that read Verilog; those that read VHDL.
        static constexpr Targets All() noexcept { return Targets(0x1FFU); }
        static constexpr Targets Verilog() noexcept { return Targets(0x0E7U); }
        static constexpr Targets Vhdl() noexcept { return Targets(0x118U); }
        /// \}
        /// Adds a target.
        constexpr void Add(Target target) noexcept { bits_ |= Bit(target); }
        /// Whether the target is in the set.
        constexpr bool Has(Target target) const noexcept { return (bits_ & Bit(target)) != 0; }
        /// Whether the set is empty.
        constexpr bool IsEmpty() const noexcept { return bits_ == 0; }
        /// What is in both sets.
        friend constexpr Targets operator&(Targets a, Targets b) noexcept {
            return Targets(a.bits_ & b.bits_);
        }

    private:
        explicit constexpr Targets(unsigned bits) noexcept : bits_(bits) {}
        static constexpr unsigned Bit(Target target) noexcept {
            return 1U << static_cast<unsigned>(target);
        }

        unsigned bits_ = 0;
    };

    /// What each target makes of something.
    class ORN_HDL_API Verdicts {
    public:
        /// Every target accepts.
        constexpr Verdicts() noexcept = default;
        /// One letter a target, in the order of `Target`: "r" rejects, "m" misreads, "w" warns, any
        /// other accepts. Targets without a letter accept.
        explicit constexpr Verdicts(std::string_view letters) noexcept {
            for (std::size_t i = 0; i < TargetCount && i < letters.size(); ++i) {
                verdicts_[i] = FromLetter(letters[i]);
            }
        }
        /// What one target makes of it.
        constexpr Verdict Get(Target target) const noexcept {
            return verdicts_[static_cast<std::size_t>(target)];
        }
        /// Sets what one target makes of it.
        constexpr void Set(Target target, Verdict verdict) noexcept {
            verdicts_[static_cast<std::size_t>(target)] = verdict;
        }
        /// The worst of all verdicts.
        Verdict GetWorst() const noexcept;
        /// Lets every other target accept.
        void Restrict(Targets targets) noexcept;
        /// Takes the worse of both verdicts for each target.
        void Worsen(const Verdicts& other) noexcept;

        friend bool operator==(const Verdicts& a, const Verdicts& b) noexcept {
            return a.verdicts_ == b.verdicts_;
        }

    private:
        static constexpr Verdict FromLetter(char letter) noexcept {
            return letter == 'r'   ? Verdict::Rejects
                   : letter == 'm' ? Verdict::Misreads
                   : letter == 'w' ? Verdict::Warns
                                   : Verdict::Accepts;
        }

        std::array<Verdict, TargetCount> verdicts_ = {};
    };

    /// A rule. Its name is stable, and its texts are those of the documentation.
    struct Rule {
        std::string_view name;
        /// What targets make of it in general; a finding says it exactly.
        Verdicts verdicts;
        /// What is written, in one line.
        std::string_view what;
        /// Why it is wrong, with the clause of the standard.
        std::string_view why;
        /// Commands that give the finding, one a line.
        std::string_view example;
        /// What helps.
        std::string_view help;
    };

    /// Which command brought something into the design. The names stand as the design has them.
    struct Cause {
        /// What the command did.
        enum class Kind {
            /// Nothing in particular: the design as a whole.
            Design,
            /// Named the design.
            DesignName,
            /// Added the component `first`.
            Component,
            /// Added the pin `second` to the component `first`.
            Pin,
            /// Added the instance `first`.
            Instance,
            /// Was the first to name the signal `first`, or a bus, bit or slice of that base name.
            /// When both a bus and a scalar signal have the name, `second` is "bus" or "scalar".
            Signal,
            /// Wired the pin `second` of the instance `first`, or tied it to a constant.
            Connection,
            /// Made the signal `second` an alias of `first`.
            Alias,
            /// Tied the signal `first` to a constant.
            Constant,
            /// \{
            /// Gave the attribute `second`, or its value, type or option, to the module or to the
            /// component, instance or signal `first`.
            ModuleAttribute,
            ComponentAttribute,
            InstanceAttribute,
            SignalAttribute,
            /// \}
            /// Added the text `first` as a comment, or to the notes.
            Comment,
            /// Added the library `first`.
            Library,
            /// Added the use clause `first`.
            UseClause,
            /// Added the include file `first`.
            Include,
            /// Set the option of the phrase `first`.
            Option
        };
        Kind kind = Kind::Design;
        std::string first;
        std::string second;
    };

    /// Something found.
    struct ORN_HDL_API Finding {
        const Rule* rule = nullptr;
        /// What the targets asked about make of it.
        Verdicts verdicts;
        /// The objects concerned, as long as the design holds them.
        std::vector<const Object*> objects;
        /// What was found, in one line without a full stop.
        std::string message;
        /// What each language reads, and whatever else is worth a line.
        std::vector<std::string> notes;
        /// The command that brought it in.
        Cause cause;
        /// The command that brought in the other half of a clash; `Design` for none.
        Cause other;

        /// The severity that follows from the verdicts.
        Severity GetSeverity() const noexcept;
        /// The targets that make of it what `verdict` says.
        std::vector<Target> GetTargets(Verdict verdict) const;
    };

    /// Checks the design as it stands. What is found comes in the order of the topics.
    /// \param targets whose verdicts count; a rule that no target of them minds finds nothing.
    static std::vector<Finding> Run(const Netlist& netlist, const HdlOptions& options,
                                    Targets targets = Targets::All());

    /// All rules, in the order of the documentation.
    static const std::vector<Rule>& GetRules();
    /// The rule of that name; null when there is none.
    static const Rule* FindRule(std::string_view name);
    /// The name of a target, such as "vhdl-93".
    static std::string_view GetName(Target target) noexcept;
    /// The target of that name, letter case ignored. \return false when there is none.
    static bool FindTarget(std::string_view name, Target& target) noexcept;
    /// Every target, in order.
    static std::array<Target, TargetCount> GetTargets() noexcept;
};

} // namespace Orn_Hdl
