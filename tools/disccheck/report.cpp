#include "report.h"

#include <algorithm>
#include <cstdio>

namespace {

const char* SeverityName(Severity severity) {
    return severity == Severity::Error ? "error" : "warning";
}

std::size_t Count(const DiscReport& report, Severity severity) {
    return static_cast<std::size_t>(
        std::count_if(report.findings.begin(), report.findings.end(),
                      [severity](const Finding& finding) { return finding.severity == severity; }));
}

std::string Counted(std::size_t count, const char* noun) {
    return std::to_string(count) + " " + noun + (count == 1 ? "" : "s");
}

std::string EditionSource(const DiscReport& report) {
    return report.editionGiven ? "--edition" : "ORVAK.INI";
}

// Text as a JSON string: quotes, backslashes and control characters escaped, the rest (UTF-8)
// kept as it is.
std::string Quoted(const std::string& text) {
    std::string out = "\"";
    for (char c : text) {
        switch (c) {
            case '"':
                out += "\\\"";
                break;
            case '\\':
                out += "\\\\";
                break;
            case '\n':
                out += "\\n";
                break;
            case '\r':
                out += "\\r";
                break;
            case '\t':
                out += "\\t";
                break;
            default:
                if (static_cast<unsigned char>(c) < 0x20) {
                    char escaped[8];
                    std::snprintf(escaped, sizeof escaped, "\\u%04x", c);
                    out += escaped;
                } else {
                    out += c;
                }
        }
    }
    return out + "\"";
}

}  // namespace

int ExitCodeFor(const DiscReport& report) {
    return report.findings.empty() ? 0 : 1;
}

std::string TextReport(const std::string& folder, const DiscReport& report) {
    std::string text;
    for (const Finding& finding : report.findings) {
        std::string severity = SeverityName(finding.severity);
        severity.resize(9, ' ');
        text += severity + finding.path + ": " + finding.problem + " -> " + finding.effect + "\n";
    }
    text += "disccheck: " + folder + ", edition " + std::to_string(report.edition) + " (" +
            EditionSource(report) + "): ";
    if (report.findings.empty()) return text + "no problems found\n";
    return text + Counted(Count(report, Severity::Error), "error") + ", " +
           Counted(Count(report, Severity::Warning), "warning") + "\n";
}

std::string JsonReport(const std::string& folder, const DiscReport& report) {
    std::string json = "{\n  \"folder\": " + Quoted(folder) +
                       ",\n  \"edition\": " + std::to_string(report.edition) +
                       ",\n  \"editionFrom\": " + Quoted(EditionSource(report)) +
                       ",\n  \"errors\": " + std::to_string(Count(report, Severity::Error)) +
                       ",\n  \"warnings\": " + std::to_string(Count(report, Severity::Warning)) +
                       ",\n  \"findings\": [";
    for (std::size_t i = 0; i < report.findings.size(); ++i) {
        const Finding& finding = report.findings[i];
        json += std::string(i == 0 ? "\n" : ",\n") +
                "    {\"severity\": " + Quoted(SeverityName(finding.severity)) +
                ", \"path\": " + Quoted(finding.path) +
                ", \"problem\": " + Quoted(finding.problem) +
                ", \"effect\": " + Quoted(finding.effect) + "}";
    }
    return json + (report.findings.empty() ? "]\n}\n" : "\n  ]\n}\n");
}
