#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <string>

#include "host/Export.h"
#include "host/TCIMValue.h"
#include "host/TZELException.h"

namespace NORVZEL20 {

class TCIMReference;

/// What the store refuses, and why. what() is the text of the status and the names of what was refused:
/// `Already exists: instance Disk.Id="sda"`.
///
/// If there is no memory for the names, what() is the text of the status alone. Copying never throws.
/// Threads: any, at any time.
class CIMDELTA_EXPORT TStoreRefusal : public TZELException {
  public:
    /// `describe()` returns what was refused, for people.
    template <class TDescribe>
    TStoreRefusal(TZELStatusCode::EStatusCode status, const TDescribe& describe) noexcept : TZELException(status)
    {
        try {
            fText = Compose(describe());
        } catch (const std::exception&) {
            fText.reset();
        }
    }
    TStoreRefusal(const TStoreRefusal& other) noexcept = default;
    TStoreRefusal& operator=(const TStoreRefusal& other) noexcept = default;
    ~TStoreRefusal() noexcept override;

    const char* what() const noexcept override { return fText ? fText->c_str() : TZELException::what(); }

    /// The path within its namespace as it was written (TCIMReference::ToText), cut off after 200 bytes.
    static std::string Shown(TCIMReference path);

    /// " is uint64, not string": what an element is, and what the refused one would have been.
    static std::string OfOtherType(TCIMValue::TCIMType type, TCIMValue::TCIMType refused);

  private:
    boost::shared_ptr<const std::string> Compose(const std::string& refused) const;

    boost::shared_ptr<const std::string>
        fText;  // shared, because a copy of an exception must not fail; null if there was no memory
};

}  // namespace NORVZEL20
