#pragma once

#include "catalogue/cataloguelock.h"

/// Makes the program's own folder with the empty catalogue that ships with the program, at the very
/// first start of a user: only if the folder is the user's own and is not there. A catalogue that
/// is missing in a folder that exists is never made anew. Made beside its place and renamed, so
/// that it is there whole or not at all; the lock of the new catalogue is taken before another
/// start can see it. Throws Error.
CatalogueLock provisionCatalogue();
