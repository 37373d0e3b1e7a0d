// Counts the memory that the test program holds: every block from operator new, in the program and in what it loads.
#pragma once

long live_allocations();
