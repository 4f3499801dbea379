#include "client/commands/TCountingDifferences.h"

#include "client/text/Counted.h"

namespace NORVZEL20 {

namespace {

class TCountedDifferences final : public IDifferences {
  public:
    TCountedDifferences(std::shared_ptr<IDifferences> all, std::shared_ptr<std::atomic<std::uint64_t>> read)
        : fAll(std::move(all)), fRead(std::move(read))
    {}

    TDifferenceCounts GetCounts() const override { return fAll->GetCounts(); }

    void ForEach(const TCallback& callback) override
    {
        fRead->store(0, std::memory_order_relaxed);
        fAll->ForEach([&](const TDifference& difference) {
            callback(difference);
            fRead->fetch_add(1, std::memory_order_relaxed);
        });
    }

  private:
    const std::shared_ptr<IDifferences> fAll;
    const std::shared_ptr<std::atomic<std::uint64_t>> fRead;
};

}  // namespace

TCountingDifferences::TCountingDifferences(TComparisonReport& report)
    : fReport(report), fAll(report.differences), fTotal(fAll->GetCounts().GetTotal()),
      fRead(std::make_shared<std::atomic<std::uint64_t>>(0))
{
    report.differences = std::make_shared<TCountedDifferences>(fAll, fRead);
}

std::string TCountingDifferences::Describe() const
{
    const std::uint64_t read = fRead->load(std::memory_order_relaxed);
    return fTotal == 0
               ? std::string()
               : std::to_string(read * 100 / fTotal) + " % (" + std::to_string(read) + " of " + Counted(fTotal, "difference") + ")";
}

}  // namespace NORVZEL20
