#include "VLWS_IntVector.h"

// Every member compiled once, here, for all users.
template class VLWS_Vector<int32_t, 1073741823u>;
