// How a failure becomes an exception: a fixed message, its "%s" replaced by the texts it is about.
#pragma once

#include <initializer_list>
#include <string_view>

namespace Orn_Hdl {

/// A part of the library as its exceptions name it.
struct SourceUnit {
    const char* name;
    const char* revision;
};

inline constexpr SourceUnit EngineUnit{"../s/HdlEngine", "$Revision: 1.5 $"};
inline constexpr SourceUnit CommandUnit{"../s/HdlCmd", "$Revision: 1.19 $"};
inline constexpr SourceUnit LegalUnit{"../s/Legal", "$Revision: 1.0 $"};
inline constexpr SourceUnit ModelUnit{"../s/HdlModel", "$Revision: 1.8 $"};
inline constexpr SourceUnit ProofUnit{"../s/Proof", "$Revision: 1.0 $"};
inline constexpr SourceUnit ReaderUnit{"../s/Readers", "$Revision: 1.1 $"};

/// Throws an Orn_Hdl::Exception. The texts are inserted as they stand, "%" included.
[[noreturn]] void Fail(const SourceUnit& unit, int line, std::string_view message,
                       std::initializer_list<std::string_view> texts = {});

} // namespace Orn_Hdl
