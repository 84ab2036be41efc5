// Marks Windows programs "run from swap" for removable and network media. GNU ld has no
// option for these two characteristics, so the build sets them after linking.
#include <cstdio>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <string>
#include <vector>

#include "pe_header.h"

namespace {

bool MarkFile(const char* path, std::string& error) {
    std::ifstream in(path, std::ios::binary);
    if (!in) {
        error = "cannot read the file";
        return false;
    }
    std::vector<std::uint8_t> image((std::istreambuf_iterator<char>(in)),
                                    std::istreambuf_iterator<char>());
    in.close();
    if (!runfromswap::AddCharacteristics(
            image, runfromswap::kRemovableRunFromSwap | runfromswap::kNetRunFromSwap, error)) {
        return false;
    }
    // Written beside the program and then renamed over it, so a failed write never leaves a
    // half program that the build would take for up to date.
    const std::string temporary = std::string(path) + ".runfromswap";
    std::ofstream out(temporary, std::ios::binary | std::ios::trunc);
    out.write(reinterpret_cast<const char*>(image.data()),
              static_cast<std::streamsize>(image.size()));
    out.close();
    std::error_code ignored;
    std::filesystem::permissions(temporary, std::filesystem::status(path, ignored).permissions(),
                                 ignored);
    if (!out || std::rename(temporary.c_str(), path) != 0) {
        std::remove(temporary.c_str());
        error = "cannot write the file";
        return false;
    }
    return true;
}

}  // namespace

int main(int argc, char** argv) {
    if (argc < 2) {
        std::fprintf(stderr, "usage: runfromswap <program.exe>...\n");
        return 2;
    }
    for (int i = 1; i < argc; ++i) {
        std::string error;
        if (!MarkFile(argv[i], error)) {
            std::fprintf(stderr, "runfromswap: %s: %s\n", argv[i], error.c_str());
            return 1;
        }
    }
    return 0;
}
