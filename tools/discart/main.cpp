#include <cstdio>
#include <filesystem>
#include <string>

#include "catalogue.h"

namespace {

int Usage() {
    std::fprintf(
        stderr,
        "usage: discart resources <outdir>   pictures, palette, sounds, icon, pictures.rc\n"
        "       discart backgrounds <outdir> the eighteen language backgrounds\n");
    return 2;
}

}  // namespace

int main(int argc, char** argv) {
    if (argc != 3) return Usage();
    const std::string command = argv[1];
    const std::string directory = argv[2];
    if (command != "resources" && command != "backgrounds") return Usage();
    std::error_code ignored;
    std::filesystem::create_directories(directory, ignored);
    std::string error;
    const bool done = command == "resources" ? discart::GenerateResources(directory, error)
                                             : discart::GenerateBackgrounds(directory, error);
    if (!done) {
        std::fprintf(stderr, "discart: %s\n", error.c_str());
        return 1;
    }
    return 0;
}
