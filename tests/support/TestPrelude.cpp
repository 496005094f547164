#include "tests/support/TestPrelude.h"
