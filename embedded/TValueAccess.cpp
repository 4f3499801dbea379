#include "embedded/TValueAccess.h"
