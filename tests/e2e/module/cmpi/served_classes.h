// The records of the classes that providers.def lists.
#pragma once

#include "schema/TST_Alert.h"
#include "schema/TST_Box.h"
#include "schema/TST_Broken.h"
#include "schema/TST_Holds.h"
#include "schema/TST_Item.h"
#include "schema/TST_Keyed.h"
#include "schema/TST_Labels.h"
#include "schema/TST_Refusal.h"
