// Server paper records are plain values; this unit keeps the library
// non-empty while its readers grow around it.
#include "db/PageAttributes.h"
