#include "host/TCIMValue.h"
