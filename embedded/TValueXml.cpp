#include "embedded/TValueXml.h"
