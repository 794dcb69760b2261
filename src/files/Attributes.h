// SPDX-License-Identifier: MIT
#pragma once

// Gives the open file fd the extended attributes of the open file from (user and security
// attributes, and with them its access control list), and takes from it those that from lacks
// (an access list inherited from the folder, say). False when the file system refuses one: the
// caller must then keep the old file rather than lose them.
bool TakeAttributesOf(int from, int fd);
