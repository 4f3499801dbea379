#include "client/collect/DigestFile.h"

#include <openssl/evp.h>
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

constexpr std::string_view kPrivateKey = "PRIVATE KEY-----";
constexpr std::size_t kDigestedAtOnce = 64U << 10U;

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
        // The words may lie across two pieces.
        fEnd += piece;
        fHasKey |= fEnd.find(kPrivateKey) != std::string::npos;
        fEnd.erase(0, fEnd.size() - std::min(fEnd.size(), kPrivateKey.size() - 1));
    }

    bool HasKey() const noexcept { return fHasKey; }

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
