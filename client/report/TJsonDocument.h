#pragma once

#include <nlohmann/json.hpp>
#include <string>

#include "client/report/TTextSink.h"

namespace NORVZEL20 {

/// Writes an object as WriteJson(object, isIndented) would, without holding it: its members one after the other, and of a member
/// that is a list, the elements one after the other.
///
/// Errors of all operations: what the sink throws; std::bad_alloc. The text has no end then.
class TJsonDocument {
  public:
    /// Starts the object. Names need no escapes.
    explicit TJsonDocument(TTextSink sink, bool isIndented = true);

    /// Adds a member.
    void Add(const std::string& name, const nlohmann::ordered_json& value);

    /// Adds a member that is a list. Until EndList, only AddElement may be called.
    void StartList(const std::string& name);
    void AddElement(const nlohmann::ordered_json& value);
    void EndList();

    /// Ends the object and the line.
    void End();

  private:
    std::string Text(const char* start, const nlohmann::ordered_json& value) const;
    std::string MemberBegin(const std::string& name) const;

    const TTextSink fSink;
    const bool fIsIndented;
    bool fIsEmpty = true;      // whether the object has no member yet
    bool fIsListEmpty = true;  // the same of the list
};

}  // namespace NORVZEL20
