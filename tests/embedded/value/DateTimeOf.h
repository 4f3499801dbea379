#pragma once

#include <gtest/gtest.h>

#include <string>

#include "host/TCIMDateTime.h"

namespace NORVZEL20 {

/// The datetime of a text, which must be one.
inline TCIMDateTime DateTimeOf(const std::string& text)
{
    TCIMDateTime time;
    EXPECT_TRUE(TCIMDateTime::Parse(text, time)) << text;
    return time;
}

}  // namespace NORVZEL20
