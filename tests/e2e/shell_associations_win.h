// What the shell opens web addresses, help pages and videos with, for one test. The classes
// keys it reads are set aside while the test runs (so nothing is associated, not even Wine's
// own browser) and put back as they were when it ends.
#ifndef AUTOPLAY_TESTS_SHELL_ASSOCIATIONS_WIN_H
#define AUTOPLAY_TESTS_SHELL_ASSOCIATIONS_WIN_H

#include <string>

class ShellAssociations {
  public:
    ShellAssociations();
    ~ShellAssociations();
    ShellAssociations(const ShellAssociations&) = delete;
    ShellAssociations& operator=(const ShellAssociations&) = delete;

    // http and https addresses open with `program`, given the address as its argument.
    void OpenWebAddressesWith(const std::wstring& program) const;
    // Files ending in `extension` (".htm", ".mpg") open with `program`, given the file.
    void OpenFilesWith(const wchar_t* extension, const std::wstring& program) const;
    // Everything above opens with the test viewer.
    void OpenEverythingWithViewer() const;
    // Web addresses lose their program again.
    void ForgetWebAddresses() const;
    void ForgetFiles(const wchar_t* extension) const;
};

// The logging viewer built beside the tests (disc/companions/viewer_main.cpp).
std::wstring ViewerProgram();

#endif
