#pragma once

/// Gives one open file what the other has besides its content: owner, rights, access list, extended
/// attributes, time of the last access; attributes that the other lacks go. False where the system
/// does not let it.
bool takeOverRights(int target, int source);
