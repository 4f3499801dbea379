// Certificates in files of the system's folders. A link is not followed: what it leads to is in one of the folders too, or in a
// file that holds all authorities of the system.
#include <algorithm>
#include <array>

#include "client/collect/CollectKinds.h"
#include "client/collect/HoldsSecrets.h"
#include "client/collect/TFileWalk.h"
#include "client/collect/read/ReadCertificates.h"
#include "client/collect/read/TextPieces.h"

namespace NORVZEL20 {

namespace {

constexpr std::array<const char*, 3> kCertificateFolders = {"/etc", "/usr/local/etc", "/usr/local/share/ca-certificates"};
constexpr std::array<const char*, 5> kCertificateSuffixes = {".pem", ".crt", ".cer", ".cert", ".der"};
constexpr std::size_t kMostCertificateFileBytes = 16U << 20U;

bool MayHoldCertificates(const std::string& path)
{
    return !HoldsSecrets(path) && std::any_of(kCertificateSuffixes.begin(), kCertificateSuffixes.end(),
                                              [&path](const char* suffix) { return EndsWith(path, suffix); });
}

// Returns whether to go into it if it is a folder.
bool AddCertificates(TCollection& collection, const std::string& path, const struct stat& status)
{
    const bool isFolder = S_ISDIR(status.st_mode);
    if (!isFolder && (!S_ISREG(status.st_mode) || !MayHoldCertificates(path))) {
        return false;
    }
    if (collection.IsLeftToRoot(status)) {
        collection.LeaveToRoot(path);
        return false;
    }
    if (isFolder) {
        return true;
    }
    const TFileText file = collection.GetRoot().Read(path, kMostCertificateFileBytes);
    if (!file.trouble.empty()) {
        collection.LeaveOut(path, file.trouble);
        return true;
    }
    TReadFaults faults;
    const std::vector<TFacts> certificates = ReadCertificates(file.text, path, faults);
    collection.AddAll(certificates);
    collection.LeaveOutLines(path, faults);
    if (certificates.empty() && faults.GetCount() == 0 && (EndsWith(path, ".der") || EndsWith(path, ".cer"))) {
        collection.LeaveOut(path, "found a file that cannot be read, expected a certificate");
    }
    return true;
}

}  // namespace

void CollectCertificates(TCollection& collection)
{
    TFileWalk walk(
        collection, [&collection](const std::string& path) { return !collection.IsExcluded(path); },
        [&collection](const std::string& path, const struct stat& status) { return AddCertificates(collection, path, status); });
    for (const char* const folder : kCertificateFolders) {
        walk.Walk(folder);
    }
}

}  // namespace NORVZEL20
