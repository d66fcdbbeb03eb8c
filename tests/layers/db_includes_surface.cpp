// A database routine that reached up for a control: must not build.
#include "db/local_databases.h"
#include "surface/surface.h"
