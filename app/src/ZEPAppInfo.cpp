#include "ZEPAppInfo.h"
