#include "client/collect/DigestFile.h"

#include <openssl/err.h>
#include <openssl/evp.h>
#include <openssl/pkcs12.h>
#include <openssl/x509.h>
#include <unistd.h>

#include <algorithm>
#include <array>
#include <boost/algorithm/hex.hpp>
#include <cerrno>
#include <iterator>
#include <memory>
#include <new>
#include <string_view>

namespace NORVZEL20 {

namespace {

// What stands in a file that holds a private key or a shared one: of PEM, PGP, PuTTY, OpenVPN and WireGuard.
constexpr std::array<std::string_view, 9> kKeyMarks = {
    "PRIVATE KEY-----", "PRIVATE KEY BLOCK-----", "PuTTY-User-Key-File", "OpenVPN Static key", "PrivateKey=",
    "PrivateKey =",     "PresharedKey=",          "PresharedKey =",      "PreSharedKey=",
};
constexpr std::size_t kMostMarkBytes = 32;
constexpr std::size_t kDigestedAtOnce = 64U << 10U;

// Parses `bytes` as DER with `parse`, and frees what it makes.
template <class T>
bool Parses(T* (*parse)(T**, const unsigned char**, long), void (*release)(T*), std::string_view bytes)
{
    const auto* at = reinterpret_cast<const unsigned char*>(bytes.data());
    T* const object = parse(nullptr, &at, static_cast<long>(bytes.size()));
    release(object);
    ERR_clear_error();
    return object != nullptr;
}

// Whether the bytes begin with a private key without words around it: encrypted, in a container, or plain.
bool BeginsWithKey(std::string_view bytes)
{
    constexpr char kSequence = 0x30;
    return !bytes.empty() && bytes.front() == kSequence &&
           (Parses<X509_SIG>(&d2i_X509_SIG, &X509_SIG_free, bytes) || Parses<PKCS12>(&d2i_PKCS12, &PKCS12_free, bytes) ||
            Parses<EVP_PKEY>(&d2i_AutoPrivateKey, &EVP_PKEY_free, bytes));
}

struct TEndDigest {
    void operator()(EVP_MD_CTX* context) const { EVP_MD_CTX_free(context); }
};

// Digests a text piece by piece, and watches for a private key in it.
class TDigest {
  public:
    TDigest() : fContext(EVP_MD_CTX_new())
    {
        if (!fContext || EVP_DigestInit_ex(fContext.get(), EVP_sha256(), nullptr) != 1) {
            throw std::bad_alloc();  // nothing else can go wrong
        }
    }

    void Add(std::string_view piece)
    {
        EVP_DigestUpdate(fContext.get(), piece.data(), piece.size());
        if (fBegin.size() < kDigestedAtOnce) {
            fBegin += piece.substr(0, kDigestedAtOnce - fBegin.size());
        }
        // The words may lie across two pieces.
        fEnd += piece;
        fHasKey |= std::any_of(kKeyMarks.begin(), kKeyMarks.end(),
                               [this](std::string_view mark) { return fEnd.find(mark) != std::string::npos; });
        fEnd.erase(0, fEnd.size() - std::min(fEnd.size(), kMostMarkBytes));
    }

    bool HasKey() const { return fHasKey || BeginsWithKey(fBegin); }

    std::string GetText()
    {
        std::array<unsigned char, EVP_MAX_MD_SIZE> bytes{};
        unsigned int length = 0;
        EVP_DigestFinal_ex(fContext.get(), bytes.data(), &length);
        std::string text = "sha256:";
        boost::algorithm::hex_lower(bytes.begin(), bytes.begin() + length, std::back_inserter(text));
        return text;
    }

  private:
    std::unique_ptr<EVP_MD_CTX, TEndDigest> fContext;
    std::string fBegin;
    std::string fEnd;
    bool fHasKey = false;
};

bool IsSame(const struct stat& a, const struct stat& b)
{
    return a.st_size == b.st_size && a.st_mtim.tv_sec == b.st_mtim.tv_sec && a.st_mtim.tv_nsec == b.st_mtim.tv_nsec &&
           a.st_ctim.tv_sec == b.st_ctim.tv_sec && a.st_ctim.tv_nsec == b.st_ctim.tv_nsec;
}

// Returns false, with the reason, if the file could not be read to its end.
bool AddBytes(int file, TDigest& digest, std::string& trouble)
{
    std::string piece(kDigestedAtOnce, '\0');
    for (std::size_t total = 0; total <= TSystemRoot::kMostBytes;) {
        const ssize_t got = read(file, piece.data(), piece.size());
        if (got == 0) {
            return true;
        }
        if (got > 0) {
            digest.Add(std::string_view(piece.data(), static_cast<std::size_t>(got)));
            total += static_cast<std::size_t>(got);
        } else if (errno != EINTR) {
            trouble = TSystemRoot::TroubleOf(errno);
            return false;
        }
    }
    trouble = "it has more than " + std::to_string(TSystemRoot::kMostBytes >> 20U) + " MiB";
    return false;
}

std::string DigestOnce(const TSystemRoot& root, const std::string& path, std::string& trouble)
{
    const TDescriptor file = root.OpenFile(path, trouble);
    TDigest digest;
    struct stat before;
    struct stat after;
    if (!file || fstat(file.Get(), &before) != 0 || !AddBytes(file.Get(), digest, trouble)) {
        return std::string();
    }
    if (fstat(file.Get(), &after) != 0 || !IsSame(before, after)) {
        trouble = "it changed while it was read";
        return std::string();
    }
    if (digest.HasKey()) {
        trouble = kSecretReason;
        return std::string();
    }
    return digest.GetText();
}

}  // namespace

std::string DigestFile(const TSystemRoot& root, const std::string& path, std::string& trouble)
{
    const std::string digest = DigestOnce(root, path, trouble);
    if (!digest.empty() || trouble == kSecretReason) {
        return digest;
    }
    // A file that is being written is whole a moment later, as a rule.
    std::string again;
    const std::string second = DigestOnce(root, path, again);
    trouble = again;
    return second;
}

}  // namespace NORVZEL20
