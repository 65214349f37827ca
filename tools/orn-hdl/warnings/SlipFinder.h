// Finds the lines of a command file that are certain to be slips.
#pragma once

#include "diagnostics/WordPlaces.h"
#include "warnings/Table.h"

#include "Orn_Hdl/Containers/PtrArray.h"
#include "Orn_Hdl/Containers/StringArray.h"

#include <bitset>
#include <cstdint>
#include <functional>
#include <optional>
#include <string>
#include <string_view>
#include <unordered_map>

namespace Orn_Hdl {
class Bus;
class BusSlice;
class Model;
class ScalarSignal;
class Signal;
} // namespace Orn_Hdl

namespace Tool {

/// A slip in the line that was just carried out.
struct FoundSlip {
    Slip slip;
    std::string message;
    /// What helps in this case; empty if the table says enough.
    std::string hint = {};
    std::optional<Mark> mark = {};
};

/// Looks at each line after it was carried out. Nearly all lines wire pins: of these only the
/// signals matter that they have made, which stand at the end of the netlist's list. Other lines
/// are told by their first letters, so that a line without a slip costs some thirty instructions.
class SlipFinder {
public:
    using Report = std::function<void(const FoundSlip&)>;

    /// \param model must outlive the finder.
    /// \param report called for each slip.
    SlipFinder(Orn_Hdl::Model& model, const WarningOptions& options, Report report);

    /// Looks at a line that was carried out.
    void Look(const Orn_Hdl::StringArray& words) {
        if (!signals_.IsAtEnd()) {
            LookAtNewSignals(words);
        }
        if (IsWorthReading(words)) {
            Read(words);
        }
    }
    /// Passes over what a line has made that failed.
    void Skip();

private:
    /// Whether the words of a line can be a slip, whatever signals it made.
    static bool IsWorthReading(const Orn_Hdl::StringArray& words) noexcept {
        const std::string_view first = words.GetView(0);
        if (first.size() < 2) {
            return false;
        }
        const int letter = first[0] | SmallLetter;
        // Of the ADD commands, those for attributes and comments have the most words.
        return letter != 'c' && letter != 'n' &&
               (letter != 'a' || (first[1] | SmallLetter) == 's' || words.GetSize() > 4);
    }

    /// Makes a capital letter small.
    static constexpr int SmallLetter = 0x20;

    /// A write sorts the list of signals, and may shorten it.
    void GoToEnd();
    void LookAtNewSignals(const Orn_Hdl::StringArray& words);
    /// Takes a signal that a line has made. \param words null if nothing is to be reported.
    void TakeNew(const Orn_Hdl::Signal& signal, const Orn_Hdl::StringArray* words);
    /// Whether the name of a scalar can be a slip. This is asked of every scalar.
    bool IsSuspicious(std::string_view name) const noexcept;
    /// Whether a name has a parenthesis or a comma, which only the names of buses and of their
    /// parts should have.
    static bool HasBracket(std::string_view name) noexcept;
    void LookAtScalar(const Orn_Hdl::Signal& signal, const Orn_Hdl::StringArray& words);
    void LookAtBus(const Orn_Hdl::Bus& bus, const Orn_Hdl::StringArray& words);
    void LookAtSlice(const Orn_Hdl::BusSlice& slice, const Orn_Hdl::StringArray* words);
    void NoteBus(const Orn_Hdl::Bus& bus);

    void Read(const Orn_Hdl::StringArray& words);
    void ReadConstant(const Orn_Hdl::StringArray& words);
    /// \param position the place of the flag; 0 if the command has none.
    void ReadFlag(const Orn_Hdl::StringArray& words, int position);
    void ReadAttribute(const Orn_Hdl::StringArray& words);
    void ReadSynthesisTool(const Orn_Hdl::StringArray& words);
    void ReadEffect(const Orn_Hdl::StringArray& words, bool isIneffective);
    /// Whether a signal, or a pin given as "instance.pin", has a single bit and no range.
    bool IsSingleBit(std::string_view target) const;

    /// A filter of the names of buses: scalars are made by the million, and nearly none has the
    /// name of a bus.
    static std::size_t GetPlace(std::string_view base) noexcept {
        if (base.empty()) {
            return 0;
        }
        const auto first = static_cast<std::size_t>(base.front() | SmallLetter);
        const auto last = static_cast<std::size_t>(base.back() | SmallLetter);
        return (base.size() * 769 + first * 37 + last) % 4096;
    }

    Orn_Hdl::Model& model_;
    const WarningOptions options_;
    const Report report_;
    /// Stands behind the last signal that was looked at.
    Orn_Hdl::Iterator<Orn_Hdl::Signal*> signals_;
    std::bitset<4096> busNames_;
    /// The buses that are ports, by their base name in small letters. A bus that is widened is
    /// replaced by another one.
    std::unordered_map<std::string, const Orn_Hdl::Bus*> ports_;
};

} // namespace Tool
