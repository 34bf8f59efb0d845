#include "ruv/ruv.h"
