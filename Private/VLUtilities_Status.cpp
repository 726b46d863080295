// Status conversion: SOAP runtime errors and store response codes to VL_WS_Status values.
#include <string.h>

#include "VLUtilities.h"
#include "VL_WS_Records.h"

namespace {

// The SOAP runtime's error numbers that have a status of their own. The numbers are read as they
// are: they are the same in every runtime version the client has been built with.
enum SoapError {
  kSoapOK = 0,
  kSoapEOF = -1,
  kSoapClientFault = 1,
  kSoapServerFault = 2,
  kSoapTagMismatch = 3,
  kSoapSyntaxError = 5,
  kSoapNoTag = 6,
  kSoapMustUnderstand = 8,
  kSoapNamespace = 9,
  kSoapFault = 12,
  kSoapNoMethod = 13,
  kSoapNoData = 14,
  kSoapFirstMethodError = 15,  // GET, PUT, DELETE, HEAD and other unsupported HTTP methods
  kSoapLastMethodError = 19,
  kSoapNull = 23,
  kSoapDuplicateID = 24,
  kSoapMissingID = 25,
  kSoapHref = 26,
  kSoapTcpError = 28,
  kSoapHttpError = 29,
  kSoapSslError = 30,
  kSoapVersionMismatch = 39,
  kSoapRequired = 42,
  kSoapProhibited = 43,
  kSoapOccurs = 44,
  kSoapLength = 45,
  kFirstHttpStatus = 100,  // the runtime reports an HTTP status other than 200 OK as the error
  kLastHttpStatus = 599
};

bool IsHttpFailure(int error) {
  return error == kSoapNoData || (error >= kSoapFirstMethodError && error <= kSoapLastMethodError) ||
         error == kSoapHttpError || (error >= kFirstHttpStatus && error <= kLastHttpStatus);
}

bool IsSoapProtocolFailure(int error) {
  switch (error) {
    case kSoapClientFault:
    case kSoapServerFault:
    case kSoapTagMismatch:
    case kSoapSyntaxError:
    case kSoapNoTag:
    case kSoapMustUnderstand:
    case kSoapNamespace:
    case kSoapFault:
    case kSoapNoMethod:
    case kSoapNull:
    case kSoapDuplicateID:
    case kSoapMissingID:
    case kSoapHref:
    case kSoapVersionMismatch:
    case kSoapRequired:
    case kSoapProhibited:
    case kSoapOccurs:
    case kSoapLength:
      return true;
    default:
      return false;
  }
}

// The response codes that have a status of their own, by operation. Any other non-zero code
// is unexpected.
struct ResponseCodeRow {
  const char* operation;
  int code;
  VL_WS_Status status;
};

const ResponseCodeRow kResponseCodes[] = {
    {"VL_WS_authorizeDevice", 1, VL_WS_E_AUTHORIZE_1},
    {"VL_WS_authorizeDevice", 2, VL_WS_E_AUTHORIZE_2},
    {"VL_WS_doPurchaseSavedBilling", 1, VL_WS_E_PURCHASE_1},
    {"VL_WS_doPurchaseSavedBilling", 2, VL_WS_E_PURCHASE_2},
    {"VL_WS_doPurchaseSavedBilling", 3, VL_WS_E_PURCHASE_3},
    {"VL_WS_doPurchaseSavedBilling", 4, VL_WS_E_PURCHASE_4},
    {"VL_WS_doPurchaseSavedBilling", 5, VL_WS_E_PURCHASE_5},
    {"VL_WS_doPurchaseSavedBilling", 6, VL_WS_E_PURCHASE_6},
    {"VL_WS_doPurchaseSavedBilling", 7, VL_WS_E_PURCHASE_7},
    {"VL_WS_doPurchaseSavedBilling", 8, VL_WS_E_PURCHASE_8},
    {"VL_WS_doPurchaseSavedBilling", 9, VL_WS_E_PURCHASE_9},
    {"VL_WS_doPurchaseSavedBilling", 10, VL_WS_E_PURCHASE_10},
    {"VL_WS_doPurchaseSavedBilling", 11, VL_WS_E_PURCHASE_11},
    {"VL_WS_doPurchaseSavedBilling", 12, VL_WS_E_PURCHASE_12},
    {"VL_WS_doPurchaseSavedBilling", 20, VL_WS_E_PURCHASE_20},
    {"VL_WS_doPurchaseSavedBilling", 21, VL_WS_E_PURCHASE_21},
    {"VL_WS_doPurchaseSavedBilling", 22, VL_WS_E_PURCHASE_22},
    {"VL_WS_getBillingInfo", 1, VL_WS_E_BILLING_INFO_1},
    {"VL_WS_getBillingInfo", 2, VL_WS_E_BILLING_INFO_2},
    {"VL_WS_getBillingInfo", 3, VL_WS_E_BILLING_INFO_3},
    {"VL_WS_getBillingInfo", 4, VL_WS_E_BILLING_INFO_4},
    {"VL_WS_assignGiftCertificateToUser", 1, VL_WS_E_GIFT_CERTIFICATE_1},
    {"VL_WS_assignGiftCertificateToUser", 2, VL_WS_E_GIFT_CERTIFICATE_2},
    {"VL_WS_calcOrderTax", 1, VL_WS_E_ORDER_TAX_1},
    {"VL_WS_calcOrderTax", 2, VL_WS_E_ORDER_TAX_2},
    {"VL_WS_calcOrderTax", 3, VL_WS_E_ORDER_TAX_3},
    {"VL_WS_calcOrderTax", 11, VL_WS_E_ORDER_TAX_11},
    {"VL_WS_calcOrderTax", 12, VL_WS_E_ORDER_TAX_12},
    {"VL_WS_calcOrderTax", 20, VL_WS_E_ORDER_TAX_20},
};

}  // namespace

VL_WS_Status VLUtilities::To_VL_WS_Status(int soapError) {
  if (soapError == kSoapOK) return VL_WS_OK;
  if (soapError == kSoapEOF) return VL_WS_E_EOF;
  if (soapError == kSoapTcpError) return VL_WS_E_CONNECT;
  if (soapError == kSoapSslError) return VL_WS_E_TLS;
  if (IsHttpFailure(soapError)) return VL_WS_E_HTTP_STATUS(soapError);
  if (IsSoapProtocolFailure(soapError)) return VL_WS_E_SOAP_FAULT(soapError);
  return VL_WS_E_UNEXPECTED;
}

VL_WS_Status VLUtilities::To_VL_WS_Status(int soapError, int responseCode, const char* operation) {
  if (soapError != kSoapOK) return To_VL_WS_Status(soapError);
  if (responseCode == 0) return VL_WS_OK;
  if (operation == 0 || operation[0] == '\0') return VL_WS_E_UNEXPECTED;
  for (const ResponseCodeRow& row : kResponseCodes) {
    if (row.code == responseCode && strcmp(row.operation, operation) == 0) return row.status;
  }
  return VL_WS_E_UNEXPECTED;
}
