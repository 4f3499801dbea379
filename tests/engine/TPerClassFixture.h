#pragma once

#include <gtest/gtest.h>

#include <string>

#include "tests/support/TCapturingLogger.h"
#include "tests/support/TComparisonRun.h"

namespace NORVZEL20 {

/// Namespaces of disks and the difference run over them.
///
/// Disk: keys Bus (uint32) and Id, Size (uint32), Label. By default everything of Disk is compared.
class TPerClassFixture : public testing::Test {
  protected:
    explicit TPerClassFixture(EHost host);

    /// The namespace at that position, which declares Disk.
    TNamespaceBuilder& Namespace(std::size_t index);
    /// Adds a disk; its label is null.
    void Disk(std::size_t index, const std::string& id, unsigned int size, unsigned int bus = 0);
    void Rules(const std::string& classes) { fComparison.Rules("<DifftoolSpec>" + classes + "</DifftoolSpec>"); }
    std::string RecordsAfterRun() { return fComparison.RecordsAfterRun(); }
    /// The disks of a namespace; see DumpInstances.
    std::string Disks(std::size_t index);

    TCapturingLogger fLog;
    TComparisonRun fComparison;

  private:
    std::size_t fDeclared = 0;
};

}  // namespace NORVZEL20
