// Which inputs get the checks that take long.
#pragma once

#include <cstddef>
#include <cstdint>
#include <vector>

namespace Fuzz {

enum class Checks { Few, All };

/// The ways in which an input is to be run, one after the other. While the fuzzer searches, one
/// input in `count` is run with all checks and the others with few; the bytes of the input decide,
/// so an input that fails will fail again. An input that is run by itself, as in a test or to
/// repeat a failure, is run both ways.
const std::vector<Checks>& ChooseChecks(const std::uint8_t* data, std::size_t size,
                                        std::size_t count);

} // namespace Fuzz
