#pragma once

// What nearly every test includes. Only presets with CIMDELTA_PRECOMPILE read this file; no test may rely on it.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <atomic>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <iostream>
#include <sstream>
#include <stdexcept>
#include <thread>

#include "cmake/precompiled/HostHeaders.h"
