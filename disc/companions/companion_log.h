// Every companion program of the sample disc records that it ran: one line with the program,
// its command line and its working folder, appended to a log that tests read.
#ifndef AUTOPLAY_DISC_COMPANION_LOG_H
#define AUTOPLAY_DISC_COMPANION_LOG_H

// The log is the file named by VEMO_COMPANION_LOG, else vemo-companions.log in %TEMP%.
// Fields are separated by tabs; the line is UTF-8.
void AppendCompanionLog(const wchar_t* program, const wchar_t* arguments);

#endif
