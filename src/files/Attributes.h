// SPDX-License-Identifier: MIT
#pragma once

#include <string>

// Gives the open file fd the extended attributes of the file at from (user and security
// attributes, and with them its access control list), and takes from it those that from lacks
// (an access list inherited from the folder, say). False when the file system refuses one: the
// caller must then keep the old file rather than lose them.
bool TakeAttributesOf(const std::string& from, int fd);
