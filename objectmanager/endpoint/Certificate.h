#pragma once

#include <sys/stat.h>

#include <array>
#include <mutex>
#include <optional>
#include <string>
#include <vector>

namespace endpoint {

/// Certificate and key for HTTPS, in PEM. The files are looked at for each client that comes: renewed ones hold for it,
/// and clients that are connected go on. What cannot be used is logged, and the former pair stays. Safe for threads.
class Certificate {
public:
    /// Throws std::invalid_argument for files that cannot be used.
    Certificate(std::string certificateFile, std::string keyFile);
    ~Certificate();
    Certificate(const Certificate&) = delete;
    Certificate& operator=(const Certificate&) = delete;

    /// In PEM.
    struct Pair {
        std::string chain;
        std::string key;
    };
    Pair current();

    /// A function of GnuTLS (gnutls_certificate_retrieve_function3) that supplies the pair of the process's one
    /// certificate: GnuTLS hands it nothing by which it could find another.
    static void* retriever();

private:
    using Stamps = std::array<std::optional<struct timespec>, 4>;

    Stamps stamps() const;
    Pair load() const;

    const std::string certificateFile;
    const std::string keyFile;
    std::mutex mutex;
    Stamps seen;
    Pair pair;
};

/// Makes a key and a certificate that it has signed itself, for these names and numeric addresses of a host, and writes
/// them into files that are not there yet; their directories are made. Throws std::invalid_argument where one is there
/// or a name is none, and std::system_error.
void makeCertificate(const std::vector<std::string>& names, const std::string& certificateFile,
                     const std::string& keyFile);

} // namespace endpoint
