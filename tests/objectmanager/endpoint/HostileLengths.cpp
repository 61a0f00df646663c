#include "tests/objectmanager/endpoint/HostileRequests.h"

namespace endpoint {
namespace {

constexpr std::size_t mebibyte = std::size_t{1} << 20U;
constexpr const char* notWellFormed = "request-not-well-formed";

HttpRequest saying(const std::string& header, const std::string& value, const std::string& version = "HTTP/1.1") {
    HttpRequest made = like("POST", "/cimom", version);
    made.headers.emplace_back(header, value);
    return made;
}

/// The body of a good request behind a head that says another length than it has.
std::string length(const std::string& said) {
    const HttpRequest made = saying("Content-Length", said);
    return headOf(made) + made.body;
}

std::string lengthOf(long more) {
    return length(std::to_string(static_cast<long>(goodRequest().body.size()) + more));
}

std::string lengths(const std::string& one, const std::string& other) {
    HttpRequest made = saying("Content-Length", one);
    made.headers.emplace_back("Content-Length", other);
    return headOf(made) + made.body;
}

std::string hexadecimal(std::size_t number) {
    char digits[20];
    std::snprintf(digits, sizeof digits, "%zx", number);
    return digits;
}

std::string chunk(const std::string& data) {
    return hexadecimal(data.size()) + "\r\n" + data + "\r\n";
}

const std::string lastChunk = "0\r\n\r\n";

/// A head that announces chunks, and these bytes.
std::string chunked(const std::string& bytes, const std::string& encoding = "chunked",
                    const std::string& version = "HTTP/1.1") {
    return headOf(saying("Transfer-Encoding", encoding, version)) + bytes;
}

std::string goodChunks() {
    return chunk(goodRequest().body) + lastChunk;
}

/// One chunk behind this in the place of its size.
std::string sized(const std::string& size) {
    return chunked(size + "\r\n" + goodRequest().body + "\r\n" + lastChunk);
}

std::string sizedBy(long more) {
    return sized(hexadecimal(static_cast<std::size_t>(static_cast<long>(goodRequest().body.size()) + more)));
}

HostileRequests announcedLengths() {
    const std::string size = std::to_string(goodRequest().body.size());
    return {
        {"no length", headOf(goodRequest()), "411"},
        {"a length below zero", length("-5")},
        {"a length with a sign", length("+" + size)},
        {"a length and a letter", length(size + "x")},
        {"a length that is not decimal", length("0x10")},
        {"an empty length", length("")},
        {"two lengths in one header", length(size + ", " + size)},
        {"two lengths", lengths(size, "5")},
        {"a length twice", lengths(size, size)},
        {"one byte more than is taken", length(std::to_string(mebibyte + 1)), "413"},
        {"that, asked for leave first",
         headOf(with("Expect", "100-continue", saying("Content-Length", std::to_string(mebibyte + 1)))), "413"},
        {"more bytes than there are numbers", length("18446744073709551616"), "413"},
        {"a length of zero before a body", length("0"), "400", notWellFormed},
        {"a length that is too small", lengthOf(-5), "400", notWellFormed},
        {"a second request within the first", length("5"), "400", notWellFormed},
        {"rubbish behind a request", bytesOf(goodRequest()) + "rubbish\r\n\r\n", "200", "none", "none", true},
    };
}

HostileRequests chunks() {
    HttpRequest both = saying("Transfer-Encoding", "chunked");
    both.body = goodChunks();
    return {
        {"a length and chunks", both},
        {"chunks of HTTP/1.0", chunked(goodChunks(), "chunked", "HTTP/1.0")},
        {"another transfer encoding", chunked(goodChunks(), "gzip"), "501 or 400"},
        {"no transfer encoding", chunked(goodChunks(), "identity"), "501 or 400"},
        {"two transfer encodings", chunked(goodChunks(), "gzip, chunked"), "501 or 400"},
        {"a transfer encoding twice", chunked(goodChunks(), "chunked, chunked"), "501 or 400"},
        {"a chunk without a size", sized("")},
        {"a size that is no number", sized("zz")},
        {"a size below zero", sized("-5")},
        {"a size with a sign", sized("+" + hexadecimal(goodRequest().body.size()))},
        {"a size with a prefix", sized("0x" + hexadecimal(goodRequest().body.size()))},
        {"a size of too many digits", sized(std::string(80, 'f')), "413"},
        {"a size that is too small", sizedBy(-5)},
        {"no end of a line behind a chunk",
         chunked(hexadecimal(goodRequest().body.size()) + "\r\n" + goodRequest().body + lastChunk)},
        {"a last line that is no header", chunked(chunk(goodRequest().body) + "0\r\nrubbish\r\n\r\n")},
        {"no chunk but the last", chunked(lastChunk), "400", notWellFormed},
        {"chunks of more than is taken", chunked(repeated(chunk(std::string(mebibyte / 4, ' ')), 5) + lastChunk),
         "413"},
        // Nobody reads it to its end.
        {"chunks of far more than is taken", chunked(repeated(chunk(std::string(mebibyte, ' ')), 10) + lastChunk),
         "413 or none"},
    };
}

} // namespace

HostileRequests hostileLengths() {
    return together({announcedLengths(), chunks()});
}

HostileRequests slowRequests() {
    return {
        {"nothing", std::string(), "none"},
        {"half a request line", std::string("POST /cim"), "none"},
        {"a head without an end", headOf(goodRequest()).substr(0, 100), "none"},
        {"a length that is too large", lengthOf(5), "none"},
        {"half a body", bytesOf(goodRequest()).substr(0, bytesOf(goodRequest()).size() - 100), "none"},
        {"a chunk that is too short", sizedBy(5), "none"},
        {"a chunk that is too large for any number", chunked("ffffffffffffffff\r\nx"), "none"},
        {"chunks without a last one", chunked(chunk(goodRequest().body)), "none"},
    };
}

} // namespace endpoint
