#pragma once

#include "objectmanager/endpoint/NameSpace.h"

#include <sys/types.h>

#include <optional>
#include <string>

namespace endpoint {

/// What a user of this host may do: root and members of the group vkcim-admin change, members of vkcim read.
/// Throws std::system_error where that cannot be known.
Caller rightsOf(const std::string& user);
/// The same for a number; nobody in particular where it has no name.
Caller rightsOf(uid_t user);

/// The user at the other end of a Unix socket; nothing where the kernel does not say.
std::optional<uid_t> peerOf(int socket);

/// Whether PAM's service vkcimd takes the password of the user and the account, from this address. May take seconds.
bool isAuthentic(const std::string& user, const std::string& password, const std::string& address);

/// User and password of a header `Authorization: Basic …`; nothing for another one.
std::optional<std::pair<std::string, std::string>> basicCredentials(std::string_view authorization);

} // namespace endpoint
