#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <string>
#include <vector>

#include "host/ICIMNamespace.h"

namespace NORVZEL20 {

/// Writes delta records as a run does, but copies them from another delta namespace.
class TRecordWriter {
  public:
    /// Reads the records of `source`.
    explicit TRecordWriter(boost::shared_ptr<ICIMNamespace> source);

    /// Adds a copy of each record to `target`, in the same order.
    void WriteInto(ICIMNamespace& target) const;

  private:
    struct TDelta {
        std::string className;
        unsigned char type;
        std::string instanceName;
        std::string property;
        std::vector<unsigned short> indices;
    };

    static boost::shared_ptr<ICIMInstance> WriteClass(ICIMNamespace& target, const std::string& name);
    static void WriteDelta(ICIMNamespace& target, const ICIMInstance& classRecord, const TDelta& delta);

    std::vector<TDelta> fDeltas;
};

}  // namespace NORVZEL20
