// Status conversion: SOAP runtime errors and store response codes.
#include <gtest/gtest.h>

#include "VLUtilities.h"
#include "VL_WS_Records.h"

namespace {

VL_WS_Status Soap(int error) { return VLUtilities::To_VL_WS_Status(error); }

TEST(StatusConversion, TransportErrorsHaveTheirOwnStatus) {
  EXPECT_EQ(0, Soap(0));
  EXPECT_EQ(-2012, Soap(-1));
  EXPECT_EQ(-2011, Soap(28));
  EXPECT_EQ(-5030, Soap(30));
}

TEST(StatusConversion, HttpFailuresAreOffsetFrom4000) {
  EXPECT_EQ(-4014, Soap(14));
  for (int e = 15; e <= 19; ++e) EXPECT_EQ(-4000 - e, Soap(e)) << e;
  EXPECT_EQ(-4029, Soap(29));
  EXPECT_EQ(-4100, Soap(100));
  EXPECT_EQ(-4200, Soap(200));
  EXPECT_EQ(-4404, Soap(404));
  EXPECT_EQ(-4503, Soap(503));
  EXPECT_EQ(-4599, Soap(599));
  EXPECT_EQ(VL_WS_E_HTTP_STATUS(503), Soap(503));
}

TEST(StatusConversion, SoapProtocolFailuresAreOffsetFrom6000) {
  const int listed[] = {1, 2, 3, 5, 6, 8, 9, 12, 13, 23, 24, 25, 26, 39, 42, 43, 44, 45};
  for (int e : listed) EXPECT_EQ(-6000 - e, Soap(e)) << e;
  EXPECT_EQ(VL_WS_E_SOAP_FAULT(2), Soap(2));  // a fault of the server
}

TEST(StatusConversion, EveryOtherErrorIsUnexpected) {
  const int others[] = {-2, 4, 7, 10, 11, 20, 21, 22, 27, 31, 40, 46, 99, 600, 1000, -6000};
  for (int e : others) EXPECT_EQ(-1004, Soap(e)) << e;
}

TEST(StatusConversion, SoapErrorWinsOverTheResponseCode) {
  EXPECT_EQ(-2011, VLUtilities::To_VL_WS_Status(28, 0, ""));
  EXPECT_EQ(-2011, VLUtilities::To_VL_WS_Status(28, 1, "VL_WS_authorizeDevice"));
  EXPECT_EQ(-6002, VLUtilities::To_VL_WS_Status(2, 5, nullptr));
  EXPECT_EQ(0, VLUtilities::To_VL_WS_Status(0, 0, "VL_WS_calcOrderTax"));
  EXPECT_EQ(0, VLUtilities::To_VL_WS_Status(0, 0, nullptr));
}

TEST(StatusConversion, ResponseCodesWithoutOperationAreUnexpected) {
  EXPECT_EQ(-1004, VLUtilities::To_VL_WS_Status(0, 1, ""));
  EXPECT_EQ(-1004, VLUtilities::To_VL_WS_Status(0, 1, nullptr));
  EXPECT_EQ(-1004, VLUtilities::To_VL_WS_Status(0, 2, "VL_WS_getTitles"));
  EXPECT_EQ(-1004, VLUtilities::To_VL_WS_Status(0, -1, "VL_WS_authorizeDevice"));
}

struct Row {
  const char* operation;
  int code;
  VL_WS_Status status;
};

TEST(StatusConversion, ResponseCodeTable) {
  const Row rows[] = {
      {"VL_WS_authorizeDevice", 1, -1005},
      {"VL_WS_authorizeDevice", 2, -1006},
      {"VL_WS_authorizeDevice", 3, -1004},
      {"VL_WS_doPurchaseSavedBilling", 13, -1004},
      {"VL_WS_doPurchaseSavedBilling", 19, -1004},
      {"VL_WS_doPurchaseSavedBilling", 20, -1028},
      {"VL_WS_doPurchaseSavedBilling", 21, -1021},
      {"VL_WS_doPurchaseSavedBilling", 22, -1022},
      {"VL_WS_doPurchaseSavedBilling", 23, -1004},
      {"VL_WS_getBillingInfo", 1, -1008},
      {"VL_WS_getBillingInfo", 2, -1017},
      {"VL_WS_getBillingInfo", 3, -1011},
      {"VL_WS_getBillingInfo", 4, -1012},
      {"VL_WS_getBillingInfo", 5, -1004},
      {"VL_WS_assignGiftCertificateToUser", 1, -1019},
      {"VL_WS_assignGiftCertificateToUser", 2, -1020},
      {"VL_WS_assignGiftCertificateToUser", 3, -1004},
      {"VL_WS_calcOrderTax", 1, -1023},
      {"VL_WS_calcOrderTax", 2, -1024},
      {"VL_WS_calcOrderTax", 3, -1025},
      {"VL_WS_calcOrderTax", 4, -1004},
      {"VL_WS_calcOrderTax", 10, -1004},
      {"VL_WS_calcOrderTax", 11, -1026},
      {"VL_WS_calcOrderTax", 12, -1027},
      {"VL_WS_calcOrderTax", 13, -1004},
      {"VL_WS_calcOrderTax", 20, -1028},
      {"VL_WS_calcOrderTax", 21, -1004},
      // Names are matched exactly.
      {"vl_ws_calcordertax", 1, -1004},
      {"VL_WS_calcOrderTax ", 1, -1004},
  };
  for (const Row& row : rows) {
    EXPECT_EQ(row.status, VLUtilities::To_VL_WS_Status(0, row.code, row.operation))
        << row.operation << " " << row.code;
  }
  for (int n = 1; n <= 12; ++n) {
    EXPECT_EQ(-1006 - n, VLUtilities::To_VL_WS_Status(0, n, "VL_WS_doPurchaseSavedBilling")) << n;
  }
}

}  // namespace
