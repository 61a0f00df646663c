#include "objectmanager/endpoint/Certificate.h"

#include "objectmanager/endpoint/Files.h"
#include "objectmanager/endpoint/Log.h"

#include <gnutls/abstract.h>
#include <gnutls/gnutls.h>

#include <algorithm>
#include <atomic>
#include <stdexcept>

namespace endpoint {
namespace {

std::atomic<Certificate*> theOne{nullptr};

gnutls_datum_t datumOf(std::string& text) {
    return {reinterpret_cast<unsigned char*>(text.data()), static_cast<unsigned>(text.size())};
}

/// Whether the key is the certificate's, among other things.
void expectUsable(Certificate::Pair& pair, const std::string& files) {
    gnutls_certificate_credentials_t credentials = nullptr;
    if (gnutls_certificate_allocate_credentials(&credentials) < 0) throw std::bad_alloc();
    const gnutls_datum_t chain = datumOf(pair.chain);
    const gnutls_datum_t key = datumOf(pair.key);
    const int status = gnutls_certificate_set_x509_key_mem(credentials, &chain, &key, GNUTLS_X509_FMT_PEM);
    gnutls_certificate_free_credentials(credentials);
    if (status < 0) throw std::invalid_argument(files + " cannot be used: " + gnutls_strerror(status));
}

constexpr unsigned longestChain = 16;

/// Copies that belong to GnuTLS, which frees them behind the handshake.
int retrieve(gnutls_session_t, const gnutls_cert_retr_st*, gnutls_pcert_st** certificates, unsigned* count,
             gnutls_ocsp_data_st** ocsp, unsigned* ocspCount, gnutls_privkey_t* key, unsigned* flags) {
    Certificate* const certificate = theOne;
    if (certificate == nullptr) return -1;
    Certificate::Pair pair = certificate->current();
    const gnutls_datum_t chainText = datumOf(pair.chain);
    const gnutls_datum_t keyText = datumOf(pair.key);
    auto* const chain = static_cast<gnutls_pcert_st*>(gnutls_calloc(longestChain, sizeof(gnutls_pcert_st)));
    unsigned found = longestChain;
    if (chain == nullptr || gnutls_pcert_list_import_x509_raw(chain, &found, &chainText, GNUTLS_X509_FMT_PEM, 0) < 0) {
        gnutls_free(chain);
        return -1;
    }
    if (gnutls_privkey_init(key) < 0 ||
        gnutls_privkey_import_x509_raw(*key, &keyText, GNUTLS_X509_FMT_PEM, nullptr, 0) < 0) {
        for (unsigned i = 0; i < found; ++i) gnutls_pcert_deinit(&chain[i]);
        gnutls_free(chain);
        return -1;
    }
    *certificates = chain;
    *count = found;
    *ocsp = nullptr;
    *ocspCount = 0;
    *flags = GNUTLS_CERT_RETR_DEINIT_ALL;
    return 0;
}

bool isSame(const std::optional<timespec>& a, const std::optional<timespec>& b) {
    return a.has_value() == b.has_value() && (!a || (a->tv_sec == b->tv_sec && a->tv_nsec == b->tv_nsec));
}

} // namespace

Certificate::Certificate(std::string certificate, std::string key)
    : certificateFile(std::move(certificate)), keyFile(std::move(key)), seen(stamps()), pair(load()) {
    theOne = this;
}

Certificate::~Certificate() {
    Certificate* self = this;
    theOne.compare_exchange_strong(self, nullptr);
}

Certificate::Pair Certificate::load() const {
    Pair loaded{contentOf(certificateFile), contentOf(keyFile)};
    expectUsable(loaded, certificateFile + " and " + keyFile);
    return loaded;
}

/// When each file changed, and was put in its place.
Certificate::Stamps Certificate::stamps() const {
    Stamps found;
    std::size_t next = 0;
    for (const std::string* file : {&certificateFile, &keyFile}) {
        struct stat status {};
        const bool there = stat(file->c_str(), &status) == 0;
        if (there) found.at(next) = status.st_mtim;
        if (there) found.at(next + 1) = status.st_ctim;
        next += 2;
    }
    return found;
}

Certificate::Pair Certificate::current() {
    const std::lock_guard lock(mutex);
    const Stamps now = stamps();
    if (!std::equal(now.begin(), now.end(), seen.begin(), isSame)) {
        seen = now; // before they are read: what changes meanwhile is read again
        try {
            pair = load();
            log("another certificate holds from now on");
        } catch (const std::exception& error) {
            log(std::string("the former certificate stays: ") + error.what());
        }
    }
    return pair;
}

void* Certificate::retriever() {
    return reinterpret_cast<void*>(&retrieve);
}

} // namespace endpoint
