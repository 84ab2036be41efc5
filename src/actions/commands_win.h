// What the launcher's commands share with the window procedure.
#ifndef AUTOPLAY_ACTIONS_COMMANDS_WIN_H
#define AUTOPLAY_ACTIONS_COMMANDS_WIN_H

// The click every command plays; it also ends the start-up music for good (the system plays
// one such sound at a time).
void PlayClickSound();

#endif
