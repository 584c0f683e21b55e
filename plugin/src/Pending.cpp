// The settings panel lands separately; until then the filter offers none.
#include "EPS.h"
