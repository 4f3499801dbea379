#pragma once

#include <boost/smart_ptr/make_shared.hpp>
#include <functional>
#include <string>
#include <utility>

#include "tests/support/watched/TWatchedNamespace.h"

namespace NORVZEL20 {

/// A namespace whose answers to GetClass a test chooses.
class TAnsweringNamespace : public TWatchedNamespace {
  public:
    using TAnswer = std::function<boost::shared_ptr<ICIMClass>(const std::string&)>;

    TAnsweringNamespace(boost::shared_ptr<ICIMNamespace> ns, TAnswer answer)
        : TWatchedNamespace(ns, boost::make_shared<TCallWatch>(), "answering"), fAnswer(std::move(answer))
    {}

    boost::shared_ptr<ICIMClass> GetClass(const std::string& name, TCallContext) override { return fAnswer(name); }

  private:
    TAnswer fAnswer;
};

}  // namespace NORVZEL20
