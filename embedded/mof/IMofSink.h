#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <string>

#include "embedded/load/TDraft.h"
#include "embedded/load/TQualifierDraft.h"
#include "embedded/mof/TMofInstance.h"
#include "embedded/mof/TMofPart.h"
#include "embedded/store/TInMemQualifierDecl.h"

namespace NORVZEL20 {

/// Takes what TMofParser reads, in the document's order.
class IMofSink {
  public:
    virtual ~IMofSink() = default;

    /// The declaration of a qualifier that has been read before; null if there is none.
    virtual boost::shared_ptr<TInMemQualifierDecl> FindQualifierDecl(const std::string& name) = 0;

    virtual void OnQualifierDecl(const TQualifierDraft& draft) = 0;
    virtual void OnClass(TDraft draft) = 0;
    /// A class with a qualifier that is not declared yet. Returns whether to go on with that class, which is then passed to
    /// OnClass; otherwise `part` is to be read again when more is declared.
    virtual bool OnUndeclared(TMofPart part) = 0;
    virtual void OnInstance(TMofInstance instance) = 0;
    /// `text` is what stands between the parentheses; the present place is that of the pragma.
    virtual void OnPragma(const std::string& name, const std::string& text) = 0;
};

}  // namespace NORVZEL20
