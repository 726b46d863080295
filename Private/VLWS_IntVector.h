// VLWS_IntVector: growable array of signed 32-bit numbers (title identifiers, episode lists).
#ifndef VLWS_INTVECTOR_H
#define VLWS_INTVECTOR_H

#include <stdint.h>

#include "VLWS_Vector.h"

extern template class VLWS_Vector<int32_t, 1073741823u>;

class VLWS_IntVector : public VLWS_Vector<int32_t, 1073741823u> {
 public:
  using VLWS_Vector::VLWS_Vector;
};

#endif  // VLWS_INTVECTOR_H
