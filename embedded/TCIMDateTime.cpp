#include "host/TCIMDateTime.h"
