// The checks that guard commands: is the launcher's own file reachable, is Disc 1 in the drive.
#ifndef AUTOPLAY_ACTIONS_CHECKS_WIN_H
#define AUTOPLAY_ACTIONS_CHECKS_WIN_H

// True to go on; false when the user cancelled the prompt for the disc.
bool CheckLauncherFile();
// True when both setup files of Disc 1 open; asks for the disc until they do or the user cancels.
bool CheckDiscFiles();
// True when the file opens for reading.
bool FileOpensForReading(const wchar_t* path);

#endif
