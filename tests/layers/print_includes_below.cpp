// A print routine with the headers of its own layer and those below it: builds.
#include "db/local_databases.h"
#include "jet/database.h"
#include "platform/context.h"
#include "print/label_page.h"
