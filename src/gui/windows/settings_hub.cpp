#include "gui/windows/settings_hub.h"

// The hub is all signals; its meta-object is built here.
#include "moc_settings_hub.cpp"
