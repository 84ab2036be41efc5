// The disc check's findings as lines for people and as JSON for build pipelines.
#ifndef AUTOPLAY_TOOLS_DISCCHECK_REPORT_H
#define AUTOPLAY_TOOLS_DISCCHECK_REPORT_H

#include <string>

#include "disc_checks.h"

// 0 when nothing is wrong, 1 when something is (2, an unreadable folder, has no report).
int ExitCodeFor(const DiscReport& report);

// One line per finding ("error    path: problem -> what the user sees"), then the summary.
std::string TextReport(const std::string& folder, const DiscReport& report);

std::string JsonReport(const std::string& folder, const DiscReport& report);

#endif
