#include "host/TCIMReference.h"
