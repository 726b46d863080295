// Status conversion: the families of SOAP runtime errors, and the order of the two sources. The
// store's response codes per operation are checked where the operations meet the store's refusals.
#include <gtest/gtest.h>

#include "VLUtilities.h"
#include "VL_WS_Records.h"

namespace {

VL_WS_Status Soap(int error) { return VLUtilities::To_VL_WS_Status(error); }

TEST(StatusConversion, EachFamilyOfRuntimeErrorsHasItsRange) {
  EXPECT_EQ(0, Soap(0));
  EXPECT_EQ(-2012, Soap(-1));
  EXPECT_EQ(-2011, Soap(28));
  EXPECT_EQ(-5030, Soap(30));
  for (int e : {14, 15, 19, 29, 100, 200, 404, 599}) EXPECT_EQ(VL_WS_E_HTTP_STATUS(e), Soap(e)) << e;
  for (int e : {1, 2, 3, 5, 6, 8, 9, 12, 13, 23, 24, 25, 26, 39, 42, 43, 44, 45})
    EXPECT_EQ(VL_WS_E_SOAP_FAULT(e), Soap(e)) << e;
  for (int e : {-2, 4, 7, 10, 11, 20, 21, 22, 27, 31, 40, 46, 600, -6000}) EXPECT_EQ(-1004, Soap(e)) << e;
}

TEST(StatusConversion, TheRuntimeErrorWinsAndCodesNeedTheirOperationsExactName) {
  EXPECT_EQ(-2011, VLUtilities::To_VL_WS_Status(28, 1, "VL_WS_authorizeDevice"));
  EXPECT_EQ(-6002, VLUtilities::To_VL_WS_Status(2, 5, nullptr));
  EXPECT_EQ(0, VLUtilities::To_VL_WS_Status(0, 0, nullptr));
  EXPECT_EQ(-1005, VLUtilities::To_VL_WS_Status(0, 1, "VL_WS_authorizeDevice"));
  for (const char* name : {"", static_cast<const char*>(nullptr), "vl_ws_authorizedevice", "VL_WS_authorizeDevice "})
    EXPECT_EQ(-1004, VLUtilities::To_VL_WS_Status(0, 1, name)) << (name ? name : "null");
  EXPECT_EQ(-1004, VLUtilities::To_VL_WS_Status(0, -1, "VL_WS_authorizeDevice"));
}

}  // namespace
