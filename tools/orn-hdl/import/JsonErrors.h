// What is wrong with a text that is no JSON, and where.
#pragma once

#include "import/JsonPath.h"

#include <simdjson.h>

#include <string>
#include <string_view>

namespace Tool::Import {

/// What the parser found, said of the file.
std::string DescribeJsonError(simdjson::error_code error);

/// The place of a byte in a text.
TextPlace FindPlace(std::string_view text, std::size_t byte);

/// The first byte that is no UTF-8; the size of the text if there is none.
std::size_t FindBadUtf8(std::string_view text);

} // namespace Tool::Import
