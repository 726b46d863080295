// VLWS_BoolVector: growable array of one-byte bools (wishlist flags beside a VLWS_IntVector).
#ifndef VLWS_BOOLVECTOR_H
#define VLWS_BOOLVECTOR_H

#include "VLWS_Vector.h"

extern template class VLWS_Vector<bool, 4294967295u>;

class VLWS_BoolVector : public VLWS_Vector<bool, 4294967295u> {
 public:
  using VLWS_Vector::VLWS_Vector;
};

#endif  // VLWS_BOOLVECTOR_H
