#pragma once

#include <string>

namespace VK {

/// The product's identifier for the host that `secret` names, as a UUID of version 8 (made by a rule of our own): the
/// first half of an HMAC-SHA256 under a fixed key, so that it does not give the secret away. Empty for an empty secret.
std::string uniqueIdentifier(const std::string& secret);

} // namespace VK
