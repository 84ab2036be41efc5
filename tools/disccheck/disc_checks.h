// Everything the launcher would find wrong in a disc folder, each with what the user will see,
// judged with the launcher's own tables (languages, pictures, strings, editions, commands).
#ifndef AUTOPLAY_TOOLS_DISCCHECK_DISC_CHECKS_H
#define AUTOPLAY_TOOLS_DISCCHECK_DISC_CHECKS_H

#include <cstdint>
#include <filesystem>
#include <optional>
#include <string>
#include <vector>

#include "locale/language_table.h"

// Errors break something the user can reach; warnings degrade it (colours, older systems).
enum class Severity { Error, Warning };

struct Finding {
    Severity severity;
    std::string path;     // below the disc folder, as the launcher names it
    std::string problem;  // what is wrong there
    std::string effect;   // what the user will see
};

struct DiscReport {
    std::uint32_t edition = 0;  // what the files were checked against
    bool editionGiven = false;  // from the command line rather than ORVAK.INI
    std::vector<Finding> findings;
};

// A language the edition can show, and for one that only an installation brings (the
// installer records another language than the one picked), the language picked.
struct ShownLanguage {
    LanguageBase base;
    LanguageBase pickedAs;  // kNoLanguage: offered by the edition itself
};
std::vector<ShownLanguage> LanguagesShownBy(std::uint32_t edition);

// English names for reports.
const char* LanguageName(LanguageBase base);

// Nothing when the folder cannot be read. `edition` replaces what ORVAK.INI says.
std::optional<DiscReport> CheckDisc(const std::filesystem::path& folder,
                                    std::optional<std::uint32_t> edition);

#endif
