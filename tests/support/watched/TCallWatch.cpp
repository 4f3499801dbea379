#include "tests/support/watched/TCallWatch.h"

#include <dlfcn.h>

#include <algorithm>
#include <boost/assert.hpp>

#include "host/TZELException.h"

namespace NORVZEL20 {

namespace {

// The library or program that contains the address. dladdr would also search for the nearest symbol, which takes longer.
const void* HolderOf(const void* address)
{
    dl_find_object found;
    return _dl_find_object(const_cast<void*>(address), &found) == 0 ? found.dlfo_link_map : nullptr;
}

// Whether the address lies in the host's own library.
bool IsOfHost(const void* caller)
{
    static const void* const host = HolderOf(reinterpret_cast<const void*>(&boost::assertion_failed));
    return HolderOf(caller) == host;
}

}  // namespace

void TCallWatch::FailCall(std::size_t number, TZELStatusCode::EStatusCode status)
{
    fCallsUntilFailure = number;
    fStatus = status;
    fHasFailed = false;
}

void TCallWatch::FailCallsOf(const std::string& start, TZELStatusCode::EStatusCode status)
{
    fFailingStart = start;
    fStatus = status;
}

void TCallWatch::StopFailing()
{
    fCallsUntilFailure = 0;
    fFailingStart.clear();
}

std::size_t TCallWatch::CountOf(const std::string& text) const
{
    const auto contains = [&](const std::string& line) { return line.find(text) != std::string::npos; };
    return static_cast<std::size_t>(std::count_if(fLines.begin(), fLines.end(), contains));
}

std::string TCallWatch::GetText() const
{
    std::string text;
    for (const auto& line : fLines) {
        text += line + "\n";
    }
    return text;
}

std::string TCallWatch::TakeText()
{
    const std::string text = GetText();
    Forget();
    return text;
}

void TCallWatch::Called(const std::string& line, const void* caller)
{
    if (IsOfHost(caller)) {
        return;
    }
    fLines.push_back(line);
    if (fCallsUntilFailure != 0 && --fCallsUntilFailure == 0) {
        fHasFailed = true;
        throw TZELException(fStatus);
    }
    if (!fFailingStart.empty() && line.compare(0, fFailingStart.size(), fFailingStart) == 0) {
        throw TZELException(fStatus);
    }
}

}  // namespace NORVZEL20
