#pragma once

#include <cstddef>
#include <map>
#include <string>
#include <utility>
#include <vector>

#include "client/collect/read/TFacts.h"

namespace NORVZEL20 {

/// What was not collected, by kind and reason.
class TOmissions {
  public:
    static constexpr std::size_t kMostSubjects = 20;  ///< that are named; the others are counted

    /// Notes that `subject`, such as a path, was not collected. `advice` is what a person can do about it; it is for the lines
    /// alone.
    void Add(const std::string& kind, const std::string& reason, const std::string& subject,
             const std::string& advice = std::string());

    /// An instance of KALMO_NotCollected for each kind and reason, in the order of their names.
    std::vector<TFacts> MakeFacts() const;

    /// A line for each kind, for people: which things, and why.
    std::vector<std::string> MakeLines() const;

  private:
    struct TSubjects {
        std::size_t count = 0;
        std::vector<std::string> named;
        std::string advice;
    };

    static std::string Describe(const TSubjects& subjects);

    std::map<std::pair<std::string, std::string>, TSubjects> fSubjects;
};

}  // namespace NORVZEL20
