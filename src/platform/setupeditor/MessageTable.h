#pragma once

#include "common/Platform.h"

// Validation messages by string-table id; an unknown id gives "Message <id>".
CString LoadMessage(unsigned id);
