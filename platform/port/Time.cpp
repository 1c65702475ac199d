#include "platform/port/Time.h"

double UT_TIME::DiffTime(std::int64_t later, std::int64_t earlier) {
    return std::difftime(later, earlier);
}

std::int64_t UT_TIME::MkTime(const std::tm& local) {
    std::tm normalised = local;
    const std::time_t time = std::mktime(&normalised);
    return time < 0 ? -1 : time;
}
