#include "embedded/services/TSpdLogger.h"

#include <spdlog/sinks/stdout_color_sinks.h>
#include <spdlog/spdlog.h>

#include <string_view>

namespace NORVZEL20 {

namespace {

spdlog::level::level_enum GetSeverity(int level)
{
    switch (level) {
    case 0:
        return spdlog::level::err;
    case 1:
        return spdlog::level::warn;
    case 2:
        return spdlog::level::info;
    default:
        return level < 0 ? spdlog::level::err : spdlog::level::debug;
    }
}

}  // namespace

// The logger is not in the registry of named loggers: the registry belongs to the program that uses this library.
TSpdLogger::TSpdLogger()
    : fLogger(std::make_shared<spdlog::logger>("cimdelta", std::make_shared<spdlog::sinks::stderr_color_sink_mt>()))
{
    fLogger->set_pattern("%Y-%m-%d %H:%M:%S.%e [%^%l%$] [%P] %v");
    fLogger->flush_on(spdlog::level::err);
}

TSpdLogger::~TSpdLogger() = default;

void TSpdLogger::Log(int level, const std::string& message)
{
    std::string_view text = message;
    if (!text.empty() && text.back() == '\n') {
        text.remove_suffix(1);
    }
    fLogger->log(GetSeverity(level), spdlog::string_view_t(text.data(), text.size()));
}

}  // namespace NORVZEL20
