#include "objectmanager/vkcim/Remote.h"

#include "objectmanager/model/Names.h"
#include "objectmanager/vkcim/RemoteMessages.h"

#include <arpa/inet.h>
#include <curl/curl.h>
#include <unistd.h>

#include <mutex>
#include <system_error>
#include <vector>

namespace vkcim {
namespace {

constexpr std::string_view unixPrefix = "unix:";
constexpr long connecting = 30;               ///< seconds
constexpr std::size_t mostBytes = 64U << 20U; ///< of an answer

std::size_t collect(char* data, std::size_t size, std::size_t count, void* target) {
    auto& body = *static_cast<std::string*>(target);
    if (body.size() + size * count > mostBytes) return 0;
    body.append(data, size * count);
    return size * count;
}

std::size_t collectError(char* data, std::size_t size, std::size_t count, void* target) {
    constexpr std::string_view name = "CIMError:";
    const std::string_view line(data, size * count);
    if (om::sameName(line.substr(0, name.size()), name)) {
        const std::size_t end = line.find_last_not_of("\r\n");
        *static_cast<std::string*>(target) = line.substr(name.size(), end + 1 - name.size());
    }
    return size * count;
}

/// Where user and password of a URL stand, behind `//`: empty for none.
std::string_view userOf(std::string_view url) {
    const std::size_t begin = url.find("//") + 2;
    const std::string_view authority = url.substr(begin, url.find_first_of("/?#", begin) - begin);
    const std::size_t at = authority.rfind('@');
    return at == std::string_view::npos ? std::string_view() : authority.substr(0, at + 1);
}

/// As it may be shown.
std::string withoutUser(const std::string& url) {
    if (url.rfind(unixPrefix, 0) == 0) return url;
    const std::string_view user = userOf(url);
    std::string shown = url;
    if (!user.empty()) shown.erase(url.find("//") + 2, user.size());
    return shown;
}

/// Whether nobody but this host sees what is sent there.
bool isLoopback(const std::string& url) {
    const std::string shown = withoutUser(url);
    const std::size_t begin = shown.find("//") + 2;
    const std::string host = shown.substr(begin, shown.find_first_of("/?#", begin) - begin);
    in_addr ipv4{};
    const std::string name = host.substr(0, host.rfind(':'));
    if (inet_pton(AF_INET, name.c_str(), &ipv4) == 1) return (ntohl(ipv4.s_addr) >> 24U) == 127;
    return om::sameName(name, "localhost") || host == "[::1]" || name == "[::1]";
}

std::string passwordFor(const std::string& user) {
    const std::string prompt = "Password of " + user + ": ";
    const char* given = getpass(prompt.c_str());
    return given != nullptr ? given : "";
}

} // namespace

class RemoteServer::Impl {
public:
    Impl(const RemoteOptions& given, const om::Schema& classes)
        : options(given), schema(classes), url(given.url), shownUrl(withoutUser(given.url)) {
        const bool known =
            url.rfind("https://", 0) == 0 || url.rfind("http://", 0) == 0 || url.rfind(unixPrefix, 0) == 0;
        if (!known) throw std::runtime_error("--url: '" + shownUrl + "' is neither https://, http:// nor unix:PATH");
        if (!options.netrcFile.empty() && access(options.netrcFile.c_str(), R_OK) != 0) {
            throw std::runtime_error("--netrc-file: " + options.netrcFile + " cannot be read"); // libcurl ignores it
        }
        const bool named = options.user || !options.netrcFile.empty() || !userOf(url).empty();
        if (named && url.rfind("http://", 0) == 0 && !isLoopback(url)) {
            throw std::runtime_error("--url: a password would cross the network in the clear to " + shownUrl +
                                     ": use https");
        }
        curl_global_init(CURL_GLOBAL_DEFAULT);
        if (url.rfind(unixPrefix, 0) == 0) {
            socket = url.substr(unixPrefix.size());
            url = "http://localhost";
        }
        if (url.find('/', url.find("//") + 2) == std::string::npos) url += "/cimom";
        if (options.user && options.netrcFile.empty()) password = passwordFor(*options.user);
    }

    ~Impl() {
        for (CURL* handle : idle) curl_easy_cleanup(handle);
    }

    om::Answer run(const om::Request& request) {
        const RemoteQuestion question = remoteQuestion(request, schema);
        CURL* const handle = take();
        std::string error;
        std::string body;
        curl_easy_setopt(handle, CURLOPT_WRITEDATA, &body);
        curl_easy_setopt(handle, CURLOPT_HEADERDATA, &error);
        curl_easy_setopt(handle, CURLOPT_POSTFIELDSIZE_LARGE, static_cast<curl_off_t>(question.body.size()));
        curl_easy_setopt(handle, CURLOPT_POSTFIELDS, question.body.c_str());
        curl_slist* headers = nullptr;
        for (const std::string& header :
             {std::string("Content-Type: application/xml; charset=\"utf-8\""), std::string("CIMOperation: MethodCall"),
              "CIMMethod: " + question.method, "CIMObject: " + question.object, std::string("Expect:")}) {
            headers = curl_slist_append(headers, header.c_str());
        }
        curl_easy_setopt(handle, CURLOPT_HTTPHEADER, headers);
        char trouble[CURL_ERROR_SIZE] = "";
        curl_easy_setopt(handle, CURLOPT_ERRORBUFFER, trouble);
        const CURLcode sent = curl_easy_perform(handle);
        curl_easy_setopt(handle, CURLOPT_ERRORBUFFER, nullptr);
        long status = 0;
        curl_easy_getinfo(handle, CURLINFO_RESPONSE_CODE, &status);
        long reason = 0;
        curl_easy_getinfo(handle, CURLINFO_OS_ERRNO, &reason);
        curl_slist_free_all(headers);
        putBack(handle);
        if (sent == CURLE_COULDNT_CONNECT && !socket.empty() && reason != 0) {
            // libcurl names the host that the URL has for it.
            throw om::LoadError(shownUrl + ": " + std::generic_category().message(static_cast<int>(reason)));
        }
        if (sent != CURLE_OK) {
            // The text says what is wrong with a certificate; the code only that something is.
            throw om::LoadError(shownUrl + ": " + (trouble[0] != '\0' ? trouble : curl_easy_strerror(sent)));
        }
        if (status != 200) throw om::LoadError(shownUrl + ": HTTP status " + std::to_string(status) + error);
        return remoteAnswer(body, request, schema);
    }

private:
    /// A handle keeps its connection.
    CURL* take() {
        const std::lock_guard lock(mutex);
        if (!idle.empty()) {
            CURL* const handle = idle.back();
            idle.pop_back();
            return handle;
        }
        return make();
    }

    void putBack(CURL* handle) {
        const std::lock_guard lock(mutex);
        idle.push_back(handle);
    }

    CURL* make() const {
        CURL* const handle = curl_easy_init();
        if (handle == nullptr) throw std::runtime_error("libcurl cannot be used");
        curl_easy_setopt(handle, CURLOPT_URL, url.c_str());
        if (!socket.empty()) curl_easy_setopt(handle, CURLOPT_UNIX_SOCKET_PATH, socket.c_str());
        curl_easy_setopt(handle, CURLOPT_WRITEFUNCTION, &collect);
        curl_easy_setopt(handle, CURLOPT_HEADERFUNCTION, &collectError);
        curl_easy_setopt(handle, CURLOPT_NOSIGNAL, 1L);
        curl_easy_setopt(handle, CURLOPT_CONNECTTIMEOUT, connecting);
        curl_easy_setopt(handle, CURLOPT_NOPROXY, "*"); // which would see the password
        curl_easy_setopt(handle, CURLOPT_PROTOCOLS_STR, "http,https");
        curl_easy_setopt(handle, CURLOPT_SSLVERSION, static_cast<long>(CURL_SSLVERSION_TLSv1_2));
        if (options.user) curl_easy_setopt(handle, CURLOPT_USERNAME, options.user->c_str());
        if (options.user && options.netrcFile.empty()) curl_easy_setopt(handle, CURLOPT_PASSWORD, password.c_str());
        if (!options.netrcFile.empty()) {
            curl_easy_setopt(handle, CURLOPT_NETRC, static_cast<long>(CURL_NETRC_OPTIONAL));
            curl_easy_setopt(handle, CURLOPT_NETRC_FILE, options.netrcFile.c_str());
        }
        if (!options.certificates.empty()) curl_easy_setopt(handle, CURLOPT_CAINFO, options.certificates.c_str());
        if (options.insecure) {
            curl_easy_setopt(handle, CURLOPT_SSL_VERIFYPEER, 0L);
            curl_easy_setopt(handle, CURLOPT_SSL_VERIFYHOST, 0L);
        }
        return handle;
    }

    const RemoteOptions options;
    const om::Schema& schema;
    std::string url;
    const std::string shownUrl;
    std::string socket;
    std::string password;
    std::mutex mutex;
    std::vector<CURL*> idle;
};

RemoteServer::RemoteServer(const RemoteOptions& options, const om::Schema& schema)
    : impl(std::make_unique<Impl>(options, schema)) {}

RemoteServer::~RemoteServer() = default;

om::Answer RemoteServer::run(const om::Request& request) {
    return impl->run(request);
}

} // namespace vkcim
