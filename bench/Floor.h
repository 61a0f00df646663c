#pragma once

#include "objectmanager/model/Values.h"

/// Sets the answer that the floor's provider makes from now on. It is not copied.
extern "C" void Floor_Prepare(const om::Answer* answer);
