// A print routine that reached up for the surface's progress bar: must not build.
#include "print/label_page.h"
#include "surface/surface_progress.h"
