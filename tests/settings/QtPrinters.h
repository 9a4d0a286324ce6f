#pragma once

// Moved to tests/support so that every test folder can use it.
#include "support/QtPrinters.h"
