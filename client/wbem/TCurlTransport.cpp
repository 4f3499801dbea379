// One handle of libcurl serves all requests, so a connection is used again.
//
// libcurl is C code and calls back for headers and bodies. An exception must not pass through it: the callback keeps it and reports
// a failure, and Post throws it again once libcurl has returned. Bodies of answers other than 2xx are pages for people. They are
// dropped, and from kMostDropped bytes on not even read.
#include "client/wbem/TCurlTransport.h"

#include <curl/curl.h>

#include <algorithm>
#include <array>
#include <boost/algorithm/string/predicate.hpp>
#include <boost/algorithm/string/trim.hpp>
#include <new>
#include <utility>

#include "client/process/TClientError.h"
#include "client/wbem/DescribeCurlFault.h"

namespace NORVZEL20 {

struct TCurlTransport::TCurl {
    std::unique_ptr<CURL, decltype(&curl_easy_cleanup)> handle{nullptr, &curl_easy_cleanup};
    std::array<char, CURL_ERROR_SIZE> words{};
};

namespace {

const std::size_t kMostDropped = 1U << 20U;

void InitializeCurl()
{
    static const CURLcode fgResult = curl_global_init(CURL_GLOBAL_DEFAULT);
    if (fgResult != CURLE_OK) {
        throw TClientError(std::string("libcurl cannot be used: ") + curl_easy_strerror(fgResult));
    }
}

// The value of a header, if the line is that header.
bool ReadHeader(const std::string& line, const char* name, std::string& value)
{
    const std::string begin = std::string(name) + ":";
    if (!boost::algorithm::istarts_with(line, begin)) {
        return false;
    }
    value = boost::algorithm::trim_copy(line.substr(begin.size()));
    return true;
}

// "HTTP/1.1 404 Not Found" begins an answer; headers of an earlier one, such as 100, do not count.
void ReadHeaderLine(const std::string& line, IHttpTransport::TAnswer& answer)
{
    if (boost::algorithm::istarts_with(line, "HTTP/")) {
        answer = IHttpTransport::TAnswer();
        const std::size_t status = line.find(' ');
        const std::size_t reason = status == std::string::npos ? status : line.find(' ', status + 1);
        answer.reason = reason == std::string::npos ? std::string() : boost::algorithm::trim_copy(line.substr(reason));
        return;
    }
    ReadHeader(line, "CIMError", answer.cimError) || ReadHeader(line, "Location", answer.location);
}

// The names in a certificate, from what libcurl lists of it.
std::string NamesInCertificate(CURL* handle)
{
    curl_certinfo* certificates = nullptr;
    if (curl_easy_getinfo(handle, CURLINFO_CERTINFO, &certificates) != CURLE_OK || certificates == nullptr ||
        certificates->num_of_certs < 1) {
        return std::string();
    }
    std::string subject;
    std::string names;
    for (const curl_slist* entry = certificates->certinfo[0]; entry != nullptr; entry = entry->next) {
        ReadHeader(entry->data, "Subject", subject);
        ReadHeader(entry->data, "X509v3 Subject Alternative Name", names);
    }
    return names.empty() ? subject : names;
}

}  // namespace

/// What the callbacks of one request share.
struct TCurlTransport::TTransfer {
    CURL* handle;
    const TSink& sink;
    TAnswer answer = {};
    std::size_t dropped = 0;
    bool hasBegun = false;
    std::exception_ptr error = nullptr;

    static std::size_t OnHeader(char* data, std::size_t size, std::size_t count, void* context) noexcept
    {
        auto& transfer = *static_cast<TTransfer*>(context);
        transfer.hasBegun = true;
        return transfer.Guard([&] { ReadHeaderLine(std::string(data, size * count), transfer.answer); }) ? size * count : 0;
    }

    static std::size_t OnBody(char* data, std::size_t size, std::size_t count, void* context) noexcept
    {
        auto& transfer = *static_cast<TTransfer*>(context);
        const std::size_t length = size * count;
        if (!transfer.IsGood()) {
            transfer.dropped += length;
            return transfer.dropped > kMostDropped ? 0 : length;
        }
        return transfer.Guard([&] { transfer.sink(std::string_view(data, length)); }) ? length : 0;
    }

    long GetStatus() const
    {
        long status = 0;
        curl_easy_getinfo(handle, CURLINFO_RESPONSE_CODE, &status);
        return status;
    }

    bool IsGood() const { return GetStatus() / 100 == 2; }

  private:
    // Returns whether the work did not throw.
    template <class TWork>
    bool Guard(const TWork& work) noexcept
    {
        try {
            work();
            return true;
        } catch (...) {
            error = std::current_exception();
            return false;
        }
    }
};

TCurlTransport::TCurlTransport(TSettings settings) : fSettings(std::move(settings)), fCurl(std::make_unique<TCurl>())
{
    InitializeCurl();
    fCurl->handle.reset(curl_easy_init());
    if (!fCurl->handle) {
        throw std::bad_alloc();
    }
    SetUp();
}

TCurlTransport::~TCurlTransport() = default;

template <class TValue>
void TCurlTransport::Set(int option, TValue value)
{
    const CURLcode code = curl_easy_setopt(fCurl->handle.get(), static_cast<CURLoption>(option), value);
    if (code == CURLE_OUT_OF_MEMORY) {
        throw std::bad_alloc();
    }
    if (code != CURLE_OK) {
        throw TClientError(std::string("libcurl cannot be used: ") + curl_easy_strerror(code));
    }
}

void TCurlTransport::SetUp()
{
    const TWbemLimits& limits = fSettings.limits;
    Set(CURLOPT_ERRORBUFFER, fCurl->words.data());
    Set(CURLOPT_NOSIGNAL, 1L);
    Set(CURLOPT_URL, fSettings.address.url.c_str());
    Set(CURLOPT_PROTOCOLS_STR, "http,https");
    Set(CURLOPT_HTTP_VERSION, static_cast<long>(CURL_HTTP_VERSION_1_1));
    Set(CURLOPT_FOLLOWLOCATION, 0L);
    Set(CURLOPT_USERAGENT, "cimdelta");
    Set(CURLOPT_ACCEPT_ENCODING, "");
    Set(CURLOPT_HTTPAUTH, static_cast<long>(CURLAUTH_BASIC));
    Set(CURLOPT_SSL_VERIFYPEER, 1L);
    Set(CURLOPT_SSL_VERIFYHOST, 2L);
    Set(CURLOPT_CERTINFO, 1L);
    if (fSettings.address.isLoopback) {
        Set(CURLOPT_PROXY, "");  // a password for this machine must not leave it
    }
    if (!fSettings.caFile.empty()) {
        Set(CURLOPT_CAINFO, fSettings.caFile.c_str());
        Set(CURLOPT_CAPATH, static_cast<char*>(nullptr));
    }
    if (fSettings.hasNetrc) {
        Set(CURLOPT_NETRC, static_cast<long>(CURL_NETRC_REQUIRED));
        Set(CURLOPT_NETRC_FILE, fSettings.netrcFile.empty() ? nullptr : fSettings.netrcFile.c_str());
    }
    Set(CURLOPT_CONNECTTIMEOUT_MS, static_cast<long>(std::min(limits.connecting, limits.silence).count()));
    Set(CURLOPT_LOW_SPEED_LIMIT, 1L);
    const auto silence = std::chrono::duration_cast<std::chrono::seconds>(limits.silence).count();
    Set(CURLOPT_LOW_SPEED_TIME, static_cast<long>(std::max<decltype(silence)>(1, silence)));
    Set(CURLOPT_HEADERFUNCTION, &TTransfer::OnHeader);
    Set(CURLOPT_WRITEFUNCTION, &TTransfer::OnBody);
}

void TCurlTransport::SetCredentials(const TWbemCredentials& credentials)
{
    Set(CURLOPT_USERNAME, credentials.user.c_str());
    Set(CURLOPT_PASSWORD, credentials.password.c_str());
}

IHttpTransport::TAnswer TCurlTransport::Post(const TPost& post, const TSink& sink)
{
    curl_slist* list = nullptr;
    // curl would wait for "100 Continue" in front of long requests, which servers of CIM rarely send.
    for (const std::string& header : post.headers) {
        list = curl_slist_append(list, header.c_str());
    }
    list = curl_slist_append(list, "Expect:");
    const std::unique_ptr<curl_slist, decltype(&curl_slist_free_all)> owner(list, &curl_slist_free_all);
    TTransfer transfer{fCurl->handle.get(), sink};
    Set(CURLOPT_HTTPHEADER, list);
    Set(CURLOPT_HEADERDATA, &transfer);
    Set(CURLOPT_WRITEDATA, &transfer);
    Set(CURLOPT_POSTFIELDSIZE_LARGE, static_cast<curl_off_t>(post.body.size()));
    Set(CURLOPT_POSTFIELDS, post.body.c_str());
    Set(CURLOPT_TIMEOUT_MS, static_cast<long>(std::max<long>(1, post.most.count())));
    fCurl->words.front() = '\0';
    const CURLcode code = curl_easy_perform(transfer.handle);
    if (transfer.error) {
        std::rethrow_exception(transfer.error);
    }
    const bool isDropped = code == CURLE_WRITE_ERROR && transfer.dropped > kMostDropped;
    if (code != CURLE_OK && !isDropped) {
        Fail(code, transfer);
    }
    transfer.answer.status = transfer.GetStatus();
    return transfer.answer;
}

void TCurlTransport::Fail(int code, const TTransfer& transfer)
{
    if (code == CURLE_OUT_OF_MEMORY) {
        throw std::bad_alloc();
    }
    TCurlFault fault;
    fault.code = code;
    fault.words = fCurl->words.front() == '\0' ? curl_easy_strerror(static_cast<CURLcode>(code)) : fCurl->words.data();
    curl_easy_getinfo(transfer.handle, CURLINFO_OS_ERRNO, &fault.systemError);
    curl_easy_getinfo(transfer.handle, CURLINFO_SSL_VERIFYRESULT, &fault.certificateError);
    fault.certificateNames = NamesInCertificate(transfer.handle);
    curl_off_t connected = 0;
    curl_easy_getinfo(transfer.handle, CURLINFO_PRETRANSFER_TIME_T, &connected);
    fault.isConnected = connected > 0;
    fault.hasAnswerBegun = transfer.hasBegun;
    throw DescribeCurlFault(fault, fSettings);
}

}  // namespace NORVZEL20
