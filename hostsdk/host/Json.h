#pragma once

#include <cstdint>
#include <nlohmann/json.hpp>
#include <string>
#include <vector>

namespace Pigmo::Host {

// JSON as the host writes and reads it: members in the order written, and numbers kept as floats
// (the values they stand for are floats), so each prints as the shortest decimal that reads back
// as the same float.
using Json = nlohmann::basic_json<nlohmann::ordered_map, std::vector, std::string, bool, std::int64_t,
                                  std::uint64_t, float>;

}  // namespace Pigmo::Host
