#include "scripts/demo_tree.h"
