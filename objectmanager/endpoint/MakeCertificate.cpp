#include "objectmanager/endpoint/Certificate.h"

#include <arpa/inet.h>
#include <fcntl.h>
#include <gnutls/crypto.h>
#include <gnutls/x509.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <ctime>
#include <filesystem>
#include <stdexcept>
#include <system_error>

namespace endpoint {
namespace {

constexpr time_t day = 24L * 60 * 60;
constexpr time_t lifetime = 3650 * day;

void checked(int status) {
    if (status < 0) throw std::runtime_error(std::string("GnuTLS: ") + gnutls_strerror(status));
}

template <class Object, int (*init)(Object*), void (*deinit)(Object)>
class Held {
public:
    Held() { checked(init(&object)); }
    ~Held() { deinit(object); }
    Held(const Held&) = delete;
    Held& operator=(const Held&) = delete;
    operator Object() const { return object; } // NOLINT(google-explicit-constructor): GnuTLS's functions take it

private:
    Object object = nullptr;
};

using Key = Held<gnutls_x509_privkey_t, gnutls_x509_privkey_init, gnutls_x509_privkey_deinit>;

/// Of letters, digits and hyphens between dots, the first part perhaps `*`; also with `_`, which hosts have.
bool isDnsName(std::string_view name) {
    constexpr std::string_view letters = "abcdefghijklmnopqrstuvwxyzABCDEFGHIJKLMNOPQRSTUVWXYZ0123456789-_";
    constexpr std::size_t longest = 253;
    constexpr std::size_t longestPart = 63;
    if (name.size() > longest) return false;
    if (name.substr(0, 2) == "*.") name.remove_prefix(2);
    for (;;) {
        const std::string_view part = name.substr(0, name.find('.'));
        if (part.empty() || part.size() > longestPart || part.front() == '-' || part.back() == '-') return false;
        if (part.find_first_not_of(letters) != std::string_view::npos) return false;
        if (part.size() == name.size()) return true;
        name.remove_prefix(part.size() + 1);
    }
}

/// What the certificate is to be valid for: a numeric address or a name.
void addName(gnutls_x509_crt_t certificate, const std::string& name) {
    unsigned char address[sizeof(in6_addr)];
    unsigned length = 0;
    if (inet_pton(AF_INET, name.c_str(), address) == 1) length = sizeof(in_addr);
    if (inet_pton(AF_INET6, name.c_str(), address) == 1) length = sizeof(in6_addr);
    if (length > 0) {
        checked(gnutls_x509_crt_set_subject_alt_name(certificate, GNUTLS_SAN_IPADDRESS, address, length,
                                                     GNUTLS_FSAN_APPEND));
    } else {
        if (!isDnsName(name)) throw std::invalid_argument("'" + name + "' is neither a host's name nor an address");
        checked(gnutls_x509_crt_set_subject_alt_name(certificate, GNUTLS_SAN_DNSNAME, name.data(),
                                                     static_cast<unsigned>(name.size()), GNUTLS_FSAN_APPEND));
    }
}

class SelfSigned : public Held<gnutls_x509_crt_t, gnutls_x509_crt_init, gnutls_x509_crt_deinit> {
public:
    SelfSigned(const std::vector<std::string>& names, gnutls_x509_privkey_t key) {
        for (const std::string& name : names) addName(*this, name);
        const std::string& first = names.front();
        unsigned char number[16];
        checked(gnutls_rnd(GNUTLS_RND_NONCE, number, sizeof number));
        number[0] = (number[0] & 0x3FU) | 0x40U; // positive, and of that length
        checked(gnutls_x509_crt_set_version(*this, 3));
        checked(gnutls_x509_crt_set_serial(*this, number, sizeof number));
        const time_t now = std::time(nullptr);
        checked(gnutls_x509_crt_set_activation_time(*this, now - day)); // clients' clocks differ
        checked(gnutls_x509_crt_set_expiration_time(*this, now + lifetime));
        checked(gnutls_x509_crt_set_dn_by_oid(*this, GNUTLS_OID_X520_COMMON_NAME, 0, first.data(),
                                              static_cast<unsigned>(first.size())));
        checked(gnutls_x509_crt_set_basic_constraints(*this, 0, -1));
        checked(gnutls_x509_crt_set_key_usage(*this, GNUTLS_KEY_DIGITAL_SIGNATURE));
        checked(gnutls_x509_crt_set_key_purpose_oid(*this, GNUTLS_KP_TLS_WWW_SERVER, 0));
        checked(gnutls_x509_crt_set_key(*this, key));
        nameKey();
        checked(gnutls_x509_crt_sign2(*this, *this, key, GNUTLS_DIG_SHA256, 0));
    }

private:
    /// By the identifiers a client finds the right one of several for the same host.
    void nameKey() {
        unsigned char identifier[64];
        std::size_t size = sizeof identifier;
        checked(gnutls_x509_crt_get_key_id(*this, 0, identifier, &size));
        checked(gnutls_x509_crt_set_subject_key_id(*this, identifier, size));
        checked(gnutls_x509_crt_set_authority_key_id(*this, identifier, size));
    }
};

template <class Object>
std::string exported(Object object, int (*toPem)(Object, gnutls_x509_crt_fmt_t, gnutls_datum_t*)) {
    gnutls_datum_t pem{};
    checked(toPem(object, GNUTLS_X509_FMT_PEM, &pem));
    std::string text(reinterpret_cast<const char*>(pem.data), pem.size);
    gnutls_free(pem.data);
    return text;
}

/// A file that is not there yet.
void writeNew(const std::string& file, mode_t mode, const std::string& content) {
    const int descriptor = open(file.c_str(), O_WRONLY | O_CREAT | O_EXCL | O_CLOEXEC, mode);
    if (descriptor < 0 && errno == EEXIST) throw std::invalid_argument(file + " is there already");
    bool written = descriptor >= 0 && fchmod(descriptor, mode) == 0 && // whatever the umask is
                   write(descriptor, content.data(), content.size()) == static_cast<ssize_t>(content.size()) &&
                   fsync(descriptor) == 0;
    const int error = errno;
    if (descriptor >= 0) close(descriptor);
    if (written) return;
    if (descriptor >= 0) unlink(file.c_str());
    throw std::system_error(error, std::generic_category(), "cannot write " + file);
}

} // namespace

void makeCertificate(const std::vector<std::string>& names, const std::string& certificateFile,
                     const std::string& keyFile) {
    const Key key;
    checked(gnutls_x509_privkey_generate(key, GNUTLS_PK_ECDSA, GNUTLS_CURVE_TO_BITS(GNUTLS_ECC_CURVE_SECP256R1), 0));
    const SelfSigned certificate(names, key);
    for (const std::string& file : {certificateFile, keyFile}) {
        const std::filesystem::path directory = std::filesystem::path(file).parent_path();
        if (!directory.empty()) std::filesystem::create_directories(directory);
    }
    writeNew(keyFile, 0600, exported<gnutls_x509_privkey_t>(key, gnutls_x509_privkey_export2));
    try {
        writeNew(certificateFile, 0644, exported<gnutls_x509_crt_t>(certificate, gnutls_x509_crt_export2));
    } catch (...) {
        unlink(keyFile.c_str());
        throw;
    }
}

} // namespace endpoint
