#include "embedded/TEmbeddedObject.h"
