#pragma once

#include "objectmanager/model/Values.h"

/// Tells the floor's provider which answer to make, until told otherwise; it is not copied.
extern "C" void Floor_Prepare(const om::Answer* answer);
