#include "VLWS_BoolVector.h"

// Every member compiled once, here, for all users.
template class VLWS_Vector<bool, 4294967295u>;
