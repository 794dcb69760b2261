// SPDX-License-Identifier: MIT
#pragma once

#include "LanguageServer.h"

// Serves one client over the descriptors until exit or the end of the input: messages are read
// on a thread of their own, checks run on another, and the protocol's state lives on this one.
// The exit status: 0 after shutdown, 1 without.
int ServeLanguageClient(int in, int out, const ServerSetup& setup);
