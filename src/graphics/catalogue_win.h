// Fonts and pictures prepared once at start-up and released at shutdown.
#ifndef AUTOPLAY_GRAPHICS_CATALOGUE_WIN_H
#define AUTOPLAY_GRAPHICS_CATALOGUE_WIN_H

// Sets the launcher's background size; 0 × 0 when no background picture could be loaded,
// which means the launcher is not running from its disc.
void LoadCatalogue();
void ReleaseCatalogue();

#endif
