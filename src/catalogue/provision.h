#pragma once

/// Makes the program's own folder with the empty catalogue that ships with the program, at the very
/// first start of a user and never again: only if the folder is the user's own, is not there and no
/// settings tell of an earlier start. Made beside its place and renamed, so that it is there whole
/// or not at all. Throws Error.
void provisionCatalogue();
