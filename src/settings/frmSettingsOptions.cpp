#include "settings/frmSettings.h"

void frmSettings::RefreshOptionStates() {}
