// Texts that the C interface hands out.
#pragma once

#include "Orn_Hdl/orn_hdl.h"

#include <cstddef>
#include <string_view>

namespace Orn_Hdl::CInterface {

/// The texts of one result. They stand in memory of the thread, which the next object of this class
/// in the same thread uses again.
class Texts {
public:
    Texts() noexcept;
    Texts(const Texts&) = delete;
    Texts& operator=(const Texts&) = delete;

    /// Copies a text. `target` stays as it is until `HandOut`.
    /// \throws std::bad_alloc
    void Put(orn_hdl_text_t& target, std::string_view text);
    /// Writes the texts to their targets.
    void HandOut() noexcept;
};

/// Hands out one text.
void HandOutText(orn_hdl_text_t& target, std::string_view text);

/// Copies a text that the caller frees.
/// \param length receives its length; may be null.
/// \throws std::bad_alloc
void HandOutCopy(std::string_view text, char** target, std::size_t* length);

} // namespace Orn_Hdl::CInterface
