#include "shell/launcher_state.h"

LauncherState launcher;
