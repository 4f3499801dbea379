#include "embedded/TValueText.h"
