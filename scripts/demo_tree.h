// Makes demo trees: a results store of invented results and the Adobe folders.
#pragma once
#include <filesystem>
