#pragma once

#include <array>
#include <cstddef>

#include "client/files/TSpooledText.h"

namespace NORVZEL20 {

/// The numbers of a page, in columns. CollectPageData.cpp draws what they stand for. Memory: at most TSpooledText::kMostInMemory a
/// column.
class TPageColumns {
  public:
    enum EColumn {
        kRowInstance,
        kRowSet,
        kRowContent,
        kRowDifference,
        kInstanceName,
        kInstanceKey,
        kInstanceLacking,
        kInstanceSharing,
        kInstancePath,
        kChangeReference,
        kChangeShort,
        kChangeGroups,
        kGroupValue,
        kGroupSet,
        kGroupCounts,
        kContentPairs,
        kContentDisagreements,
        kPairProperty,
        kPairValue,
        kDisagreementProperty,
        kDisagreementChange,
        kListNumbers,
        kNumber,
        kColumnCount
    };

    /// What the page calls the column.
    static const char* GetName(EColumn column);

    void Add(EColumn column, std::size_t number);
    std::size_t GetCount(EColumn column) const { return fCounts[column]; }
    const TSpooledText& GetNumbers(EColumn column) const { return fNumbers[column]; }

  private:
    std::array<TSpooledText, kColumnCount> fNumbers;
    std::array<std::size_t, kColumnCount> fCounts = {};
};

}  // namespace NORVZEL20
