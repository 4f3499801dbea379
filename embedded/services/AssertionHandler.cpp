// Boost calls these operations instead of aborting the process, because host/ is compiled with BOOST_ENABLE_ASSERT_HANDLER. The
// plug-in never tests a handle for null; it relies on the checks of boost::shared_ptr. A null handle throws here, and the
// exception ends the call.

#include <boost/assert.hpp>
#include <string>

#include "embedded/services/TAssertionFailure.h"
#include "embedded/services/TCoreLog.h"
#include "host/Export.h"

namespace {

[[noreturn]] void Fail(const std::string& what, const char* function, const char* file, long line)
{
    const std::string text = what + " in " + function + ", " + file + " line " + std::to_string(line);
    NORVZEL20::TCoreLog::Get()->Log(0, text);
    throw NORVZEL20::TAssertionFailure(text);
}

}  // namespace

namespace boost {

CIMDELTA_EXPORT void assertion_failed(const char* expression, const char* function, const char* file, long line)
{
    Fail(std::string("Assertion failed: ") + expression, function, file, line);
}

CIMDELTA_EXPORT void assertion_failed_msg(const char* expression, const char* message, const char* function, const char* file,
                                          long line)
{
    Fail(std::string("Assertion failed: ") + expression + " (" + message + ")", function, file, line);
}

}  // namespace boost
