// SPDX-License-Identifier: MIT
#pragma once

#include "HeaderData.h"

class Dialogs;

// Removes TAB characters from the description after telling the user; true when it did.
// It neither recomposes the header nor touches FileChanged.
bool RemoveDescriptionTabs(HeaderData& header, Dialogs& dialogs);
