// The command ids the launcher's buttons carry: each is the button's control id and arrives
// as the whole wParam of WM_COMMAND.
#ifndef AUTOPLAY_ACTIONS_COMMAND_IDS_H
#define AUTOPLAY_ACTIONS_COMMAND_IDS_H

#include <cstdint>

enum CommandId : std::uint32_t {
    kCmdInstall = 101,
    kCmdPlayPanel = 102,
    kCmdGamesPanel = 103,
    kCmdWebSite = 107,
    kCmdInfoPanel = 108,
    kCmdExit = 110,
    kCmdPlay = 150,
    kCmdPlayHighResolution = 151,
    kCmdCreator = 152,
    kCmdReadme = 301,
    kCmdSupport = 302,
    kCmdRegistration = 303,
    kCmdReinstall = 304,
    kCmdFirstLanguage = 500,
    kCmdLastLanguage = 519,
    kCmdDemoPc = 601,
    kCmdDemoDuskaro = 602,
    kCmdDemoLorrel = 603,
    kCmdDemoConsole = 604,
    kCmdAbout = 1000,
};

#endif
