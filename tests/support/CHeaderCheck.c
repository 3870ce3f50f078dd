#include "kvveldra/TagWB.h"
