// Reads the small parts that ports, nets and cells consist of.
#pragma once

#include "import/BitNumbers.h"
#include "import/ImportedDesign.h"
#include "import/JsonWalker.h"

#include "Port/TextSet.h"

#include <cstddef>
#include <cstdint>
#include <functional>
#include <string_view>

namespace Tool::Import {

/// All functions fail with the place of a part that does not have the expected form.
class PartReader {
public:
    PartReader(ImportedDesign& design, JsonWalker& walker) : design_(design), walker_(walker) {}

    /// Begins a module, whose bit indices start from 0.
    void StartModule() { bitNumbers_.StartModule(); }
    /// The number of net bits that the present module has.
    std::uint32_t CountNetBits() const noexcept { return bitNumbers_.GetCount(); }

    /// A copy of a name that many objects have, which lives as long as the design. The same name
    /// gives the same copy.
    std::string_view KeepOnce(std::string_view name);
    Direction ReadDirection();
    /// \return false, without reading anything, if `key` is not part of a range.
    bool ReadRange(std::string_view key, BitRange& range);
    Span ReadBits(Module& module);
    /// The value of a parameter or attribute. A text of the digits 0, 1, x and z is a bit vector. A
    /// text that would look like one has an extra blank at its end.
    Value ReadValue();
    Span ReadValues(Module& module);

    /// Calls `visit` with the name, kept in the design, of each field of the present value. Fails
    /// if a name occurs twice.
    template <class Visit> void ForEachNamed(const Visit& visit) {
        Port::TextSet<Hash, std::equal_to<>> names;
        walker_.ForEachField([&](std::string_view name) {
            std::string_view kept;
            if (!names.Add(name,
                           [&](std::string_view text) { return kept = design_.Keep(text); })) {
                walker_.Fail("the name occurs twice");
            }
            visit(kept);
        });
    }

private:
    struct Hash {
        std::uint64_t operator()(std::string_view text) const noexcept {
            // The upper bits of the product depend on all bits, however wide the hash is.
            const std::uint64_t hash = std::hash<std::string_view>()(text);
            return (hash ^ (hash >> 32U)) * 0x9E3779B97F4A7C15U;
        }
    };

    Bit ReadBit();

    ImportedDesign& design_;
    JsonWalker& walker_;
    BitNumbers bitNumbers_;
    /// The names of pins, parameters and attributes.
    Port::TextSet<Hash, std::equal_to<>> names_;
};

} // namespace Tool::Import
