#include "objectmanager/endpoint/Rights.h"

#include "objectmanager/model/Names.h"

#include <grp.h>
#include <pwd.h>
#include <security/pam_appl.h>
#include <sys/socket.h>

#include <algorithm>
#include <cerrno>
#include <cstdlib>
#include <cstring>
#include <system_error>
#include <vector>

namespace endpoint {
namespace {

constexpr const char* readers = "vkcim";
constexpr const char* administrators = "vkcim-admin";
constexpr unsigned failureDelay = 2'000'000; ///< microseconds, also where no module of PAM's asks for it

/// What getpwnam_r and the like find, in as much room as it takes: a group may have thousands of members. Throws
/// std::system_error where it cannot be known whether there is one.
template <class Entry>
class Found {
public:
    template <class Name>
    Found(int (*find)(Name, Entry*, char*, std::size_t, Entry**), Name name) {
        constexpr std::size_t most = std::size_t{64} << 20U;
        int error = ERANGE;
        for (std::size_t room = 16384; error == ERANGE && room <= most; room *= 2) {
            buffer.resize(room);
            error = find(name, &entry, buffer.data(), buffer.size(), &found);
        }
        const bool missing = error == ENOENT || error == ESRCH; // as some name services say it
        if (error != 0 && !missing) throw std::system_error(error, std::generic_category(), "users and groups");
    }
    Found(const Found&) = delete;
    Found& operator=(const Found&) = delete;

    explicit operator bool() const { return found != nullptr; }
    const Entry* operator->() const { return found; }
    const Entry& operator*() const { return *found; }

private:
    std::vector<char> buffer;
    Entry entry{};
    Entry* found = nullptr;
};

std::vector<gid_t> groupsOf(const std::string& user, gid_t first) {
    constexpr int mostGroups = 65536;
    std::vector<gid_t> groups(64);
    int count = static_cast<int>(groups.size());
    while (getgrouplist(user.c_str(), first, groups.data(), &count) < 0 && count < mostGroups) {
        groups.resize(static_cast<std::size_t>(count) + 64);
        count = static_cast<int>(groups.size());
    }
    groups.resize(static_cast<std::size_t>(std::max(count, 0)));
    return groups;
}

Caller rightsOf(const passwd& entry) {
    Caller caller;
    caller.user = entry.pw_name;
    const std::vector<gid_t> groups = groupsOf(caller.user, entry.pw_gid);
    const auto isIn = [&](const char* name) {
        const Found<group> wanted(getgrnam_r, name);
        return wanted && std::find(groups.begin(), groups.end(), wanted->gr_gid) != groups.end();
    };
    caller.mayChange = entry.pw_uid == 0 || isIn(administrators);
    caller.mayRead = caller.mayChange || isIn(readers);
    return caller;
}

/// Answers each question for a hidden text with the password.
int converse(int count, const pam_message** messages, pam_response** responses, void* password) {
    auto* made = static_cast<pam_response*>(std::calloc(static_cast<std::size_t>(count), sizeof(pam_response)));
    if (made == nullptr) return PAM_BUF_ERR;
    for (int i = 0; i < count; ++i) {
        if (messages[i]->msg_style == PAM_PROMPT_ECHO_OFF) made[i].resp = strdup(static_cast<const char*>(password));
    }
    *responses = made;
    return PAM_SUCCESS;
}

int sextet(char c) {
    static constexpr std::string_view letters = "ABCDEFGHIJKLMNOPQRSTUVWXYZabcdefghijklmnopqrstuvwxyz0123456789+/";
    const std::size_t found = letters.find(c);
    return found == std::string_view::npos ? -1 : static_cast<int>(found);
}

std::optional<std::string> decodeBase64(std::string_view text) {
    while (!text.empty() && text.back() == '=') text.remove_suffix(1);
    std::string decoded;
    unsigned bits = 0;
    int count = 0;
    for (const char c : text) {
        const int value = sextet(c);
        if (value < 0) return std::nullopt;
        bits = ((bits << 6U) | static_cast<unsigned>(value)) & 0xFFFFFFU;
        count += 6;
        if (count >= 8) {
            count -= 8;
            decoded += static_cast<char>((bits >> static_cast<unsigned>(count)) & 0xFFU);
        }
    }
    return decoded;
}

} // namespace

Caller rightsOf(const std::string& user) {
    const Found<passwd> entry(getpwnam_r, user.c_str());
    return entry ? rightsOf(*entry) : Caller();
}

Caller rightsOf(uid_t user) {
    const Found<passwd> entry(getpwuid_r, user);
    if (entry) return rightsOf(*entry);
    Caller caller; // root needs no entry
    caller.mayRead = caller.mayChange = user == 0;
    return caller;
}

std::optional<uid_t> peerOf(int socket) {
    ucred credentials{};
    socklen_t length = sizeof credentials;
    if (getsockopt(socket, SOL_SOCKET, SO_PEERCRED, &credentials, &length) != 0) return std::nullopt;
    return credentials.uid;
}

bool isAuthentic(const std::string& user, const std::string& password, const std::string& address) {
    std::string secret = password;
    const pam_conv conversation{converse, secret.data()};
    pam_handle_t* handle = nullptr;
    if (pam_start("vkcimd", user.c_str(), &conversation, &handle) != PAM_SUCCESS) return false;
    pam_fail_delay(handle, failureDelay);
    // What counts failures by the client, or lets in only some, looks at it.
    int status = pam_set_item(handle, PAM_RHOST, address.c_str());
    if (status == PAM_SUCCESS) status = pam_authenticate(handle, PAM_SILENT | PAM_DISALLOW_NULL_AUTHTOK);
    if (status == PAM_SUCCESS) status = pam_acct_mgmt(handle, PAM_SILENT);
    pam_end(handle, status);
    explicit_bzero(secret.data(), secret.size());
    return status == PAM_SUCCESS;
}

std::optional<std::pair<std::string, std::string>> basicCredentials(std::string_view authorization) {
    constexpr std::string_view scheme = "Basic ";
    if (!om::sameName(authorization.substr(0, scheme.size()), scheme)) return std::nullopt;
    const auto decoded = decodeBase64(authorization.substr(authorization.find_last_of(' ') + 1));
    const std::size_t colon = decoded ? decoded->find(':') : std::string::npos;
    if (colon == std::string::npos || colon == 0 || decoded->find('\0') != std::string::npos) return std::nullopt;
    return std::pair(decoded->substr(0, colon), decoded->substr(colon + 1));
}

} // namespace endpoint
