// Certificates in files. In PEM, a certificate is base64 between two lines:
//
//   -----BEGIN CERTIFICATE-----
//   MIIB...
//   -----END CERTIFICATE-----
//
// Other blocks, private keys among them, are never decoded. A file without such a line is taken for DER if it begins as a
// certificate does. A certificate is known by its file and its subject, so a renewed one is a change of the one before, and one
// more in a file of authorities is that one alone. Those with the same subject in a file are counted.
#include "client/collect/read/ReadCertificates.h"

#include <arpa/inet.h>
#include <openssl/bn.h>
#include <openssl/err.h>
#include <openssl/evp.h>
#include <openssl/x509.h>
#include <openssl/x509v3.h>

#include <algorithm>
#include <boost/algorithm/hex.hpp>
#include <ctime>
#include <iterator>
#include <map>
#include <memory>
#include <new>
#include <optional>

namespace NORVZEL20 {

namespace {

constexpr std::string_view kCertificateBegin = "-----BEGIN CERTIFICATE-----";
constexpr std::string_view kCertificateEnd = "-----END CERTIFICATE-----";
constexpr std::size_t kMostCertificateBytes = 1U << 20U;

template <class T, void (*kFree)(T*)>
struct TFreeObject {
    void operator()(T* object) const { kFree(object); }
};

using TCertificate = std::unique_ptr<X509, TFreeObject<X509, &X509_free>>;
using TBigNumber = std::unique_ptr<BIGNUM, TFreeObject<BIGNUM, &BN_free>>;
using TNames = std::unique_ptr<GENERAL_NAMES, TFreeObject<GENERAL_NAMES, &GENERAL_NAMES_free>>;

void FreeMemory(char* text)
{
    OPENSSL_free(text);
}
using TLibraryText = std::unique_ptr<char, TFreeObject<char, &FreeMemory>>;

std::string TextOf(const X509_NAME* name)
{
    const std::unique_ptr<BIO, TFreeObject<BIO, &BIO_free_all>> out(BIO_new(BIO_s_mem()));
    if (!out || X509_NAME_print_ex(out.get(), name, 0, XN_FLAG_RFC2253 & ~static_cast<unsigned long>(ASN1_STRFLGS_ESC_MSB)) < 0) {
        return std::string();
    }
    char* text = nullptr;
    const long length = BIO_get_mem_data(out.get(), &text);
    return std::string(text, static_cast<std::size_t>(std::max(0L, length)));
}

std::string SerialOf(const X509& certificate)
{
    const TBigNumber number(ASN1_INTEGER_to_BN(X509_get0_serialNumber(&certificate), nullptr));
    const TLibraryText text(number ? BN_bn2hex(number.get()) : nullptr);
    return text ? text.get() : "";
}

std::string FingerprintOf(const X509& certificate)
{
    unsigned char digest[EVP_MAX_MD_SIZE];
    unsigned int length = 0;
    std::string text;
    if (X509_digest(&certificate, EVP_sha256(), digest, &length) == 1) {
        boost::algorithm::hex_lower(digest, digest + length, std::back_inserter(text));
    }
    return text;
}

// An IPv4 or IPv6 address; empty if it is neither.
std::string AddressText(const ASN1_OCTET_STRING& bytes)
{
    constexpr int kBytes4 = 4;
    constexpr int kBytes6 = 16;
    const int length = ASN1_STRING_length(&bytes);
    char text[INET6_ADDRSTRLEN];
    const bool isAddress =
        (length == kBytes4 || length == kBytes6) &&
        inet_ntop(length == kBytes4 ? AF_INET : AF_INET6, ASN1_STRING_get0_data(&bytes), text, sizeof text) != nullptr;
    return isAddress ? text : "";
}

std::vector<std::string> AlternativeNamesOf(const X509& certificate)
{
    std::vector<std::string> list;
    const TNames names(static_cast<GENERAL_NAMES*>(X509_get_ext_d2i(&certificate, NID_subject_alt_name, nullptr, nullptr)));
    for (int i = 0; names && i < sk_GENERAL_NAME_num(names.get()); ++i) {
        const GENERAL_NAME* const name = sk_GENERAL_NAME_value(names.get(), i);
        if (name->type == GEN_DNS || name->type == GEN_EMAIL || name->type == GEN_URI) {
            const ASN1_STRING* const text = name->d.ia5;
            list.emplace_back(reinterpret_cast<const char*>(ASN1_STRING_get0_data(text)),
                              static_cast<std::size_t>(ASN1_STRING_length(text)));
        } else if (name->type == GEN_IPADD) {
            list.push_back(AddressText(*name->d.iPAddress));
        }
    }
    return list;
}

void AddTime(TFacts& facts, const char* property, const ASN1_TIME* time)
{
    std::tm parts{};
    if (time != nullptr && ASN1_TIME_to_tm(time, &parts) == 1) {
        facts.Time(property, timegm(&parts));
    }
}

TFacts FactsOf(const X509& certificate, const std::string& path, const std::string& subject, std::uint16_t number)
{
    TFacts facts("KALMO_Certificate");
    facts.Key("Path", path)
        .Key("Subject", subject)
        .Number("Number", number)
        .Text("Issuer", TextOf(X509_get_issuer_name(&certificate)))
        .Text("SerialNumber", SerialOf(certificate))
        .Text("Fingerprint", FingerprintOf(certificate))
        .Text("SignatureAlgorithm", OBJ_nid2ln(X509_get_signature_nid(&certificate)))
        .Texts("AlternativeNames", AlternativeNamesOf(certificate));
    AddTime(facts, "Issued", X509_get0_notBefore(&certificate));
    AddTime(facts, "Expires", X509_get0_notAfter(&certificate));
    const EVP_PKEY* const key = X509_get0_pubkey(&certificate);
    if (key != nullptr && EVP_PKEY_get_bits(key) > 0) {
        facts.Number("KeySize", static_cast<std::uint64_t>(EVP_PKEY_get_bits(key)));
    }
    return facts;
}

// The bytes of base64 with line ends in it; nothing if it is none.
std::optional<std::string> Decoded(std::string_view text)
{
    const std::unique_ptr<EVP_ENCODE_CTX, TFreeObject<EVP_ENCODE_CTX, &EVP_ENCODE_CTX_free>> decoder(EVP_ENCODE_CTX_new());
    if (!decoder) {
        throw std::bad_alloc();
    }
    std::string bytes(text.size() + 3, '\0');
    auto* const out = reinterpret_cast<unsigned char*>(bytes.data());
    int length = 0;
    int rest = 0;
    EVP_DecodeInit(decoder.get());
    if (text.size() > kMostCertificateBytes ||
        EVP_DecodeUpdate(decoder.get(), out, &length, reinterpret_cast<const unsigned char*>(text.data()),
                         static_cast<int>(text.size())) < 0 ||
        EVP_DecodeFinal(decoder.get(), out + length, &rest) < 0) {
        return std::nullopt;
    }
    bytes.resize(static_cast<std::size_t>(length) + static_cast<std::size_t>(rest));
    return bytes;
}

// Null if the bytes begin no certificate.
TCertificate CertificateIn(std::string_view bytes)
{
    const auto* at = reinterpret_cast<const unsigned char*>(bytes.data());
    TCertificate certificate(d2i_X509(nullptr, &at, static_cast<long>(bytes.size())));
    ERR_clear_error();
    return certificate;
}

class TCertificateList {
  public:
    explicit TCertificateList(const std::string& path) : fPath(path) {}

    void Add(const X509& certificate)
    {
        const std::string subject = TextOf(X509_get_subject_name(&certificate));
        std::uint16_t& number = fNumbers[subject];
        if (number < UINT16_MAX) {
            fFacts.push_back(FactsOf(certificate, fPath, subject, ++number));
        }
    }

    std::vector<TFacts> Take() { return std::move(fFacts); }

  private:
    const std::string& fPath;
    std::map<std::string, std::uint16_t> fNumbers;  // of the certificates with a subject
    std::vector<TFacts> fFacts;
};

}  // namespace

std::vector<TFacts> ReadCertificates(std::string_view bytes, const std::string& path, TReadFaults& faults)
{
    TCertificateList list(path);
    std::size_t begin = bytes.find(kCertificateBegin);
    if (begin == std::string_view::npos) {
        const TCertificate certificate = bytes.size() > kMostCertificateBytes ? nullptr : CertificateIn(bytes);
        if (certificate) {
            list.Add(*certificate);
        }
        return list.Take();
    }
    std::size_t line = 1;
    for (std::size_t counted = 0; begin != std::string_view::npos; begin = bytes.find(kCertificateBegin, begin)) {
        line += static_cast<std::size_t>(std::count(bytes.begin() + counted, bytes.begin() + begin, '\n'));
        counted = begin;
        begin += kCertificateBegin.size();
        const std::size_t end = bytes.find(kCertificateEnd, begin);
        if (end == std::string_view::npos) {
            faults.Add(line, "found the beginning of a certificate, expected its end");
            break;
        }
        const std::optional<std::string> decoded = Decoded(bytes.substr(begin, end - begin));
        const TCertificate certificate = decoded ? CertificateIn(*decoded) : nullptr;
        if (certificate) {
            list.Add(*certificate);
        } else {
            faults.Add(line, "found a block that cannot be read, expected a certificate");
        }
        begin = end;
    }
    return list.Take();
}

}  // namespace NORVZEL20
