// The sample disc as the build assembles it, copied for one test into a folder of its own,
// so that a test may change its edition or take files away without touching the build.
#ifndef AUTOPLAY_TESTS_SAMPLE_DISC_WIN_H
#define AUTOPLAY_TESTS_SAMPLE_DISC_WIN_H

#include <string>

class SampleDisc {
  public:
    // Copies the built disc (the "disc" folder beside the test program's folder) into a new
    // folder whose name starts with `name`.
    explicit SampleDisc(const std::wstring& name = L"autoplay-sample-disc");
    // Removes the copy; programs started from it get a few seconds to close first.
    ~SampleDisc();
    SampleDisc(const SampleDisc&) = delete;
    SampleDisc& operator=(const SampleDisc&) = delete;

    // With a trailing backslash.
    const std::wstring& Root() const { return root_; }
    std::wstring Path(const std::wstring& relativePath) const { return root_ + relativePath; }
    std::wstring Launcher() const { return Path(L"AutoPlay.exe"); }
    bool Has(const std::wstring& relativePath) const;

    // Rewrites ORVAK.INI for another edition of the disc.
    void SetEdition(int sku) const;
    // Takes a file, or a folder with everything in it, off the disc.
    void Remove(const std::wstring& relativePath) const;

  private:
    std::wstring root_;
};

#endif
