// Streaming operations against the store simulator (their answers, and that they go to the
// streaming service from a download handle too, vlws_test pins): refused arguments, the statuses
// of refused answers, THX settings and the default audio profile.
#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "VLTestAccountClient.h"

namespace {

const int kStandard = 1;     // file profile STANDARD
const int kPaused = 2;       // stream status paused
const int kDolbyPlus51 = 3;  // audio profile Dolby_Digital_Plus_51
const int kStereo = 0;       // audio profile Stereo_Standard
const int kBonusTrailer = 10015;

class Streaming : public VLTestAccountClient {
 protected:
  void TearDown() override {
    m_Sim.Store().RemoveAllPurchases(Account(), "alicepw");
    m_Sim.Store().SetAudioDefault(Account(), kDolbyPlus51);
    VLTestAccountClient::TearDown();
  }
  // A pass of the account for sku, bought in the store directly.
  int Pass(int sku) {
    VLSimPurchase purchase = m_Sim.Store().Purchase(Account(), sku, "192.0.2.17", false);
    EXPECT_EQ(0, purchase.code);
    return purchase.pass;
  }
};

TEST_F(Streaming, EmptyStreamIDIsRefusedWithoutARequest) {
  Init();
  for (const char* stream : {static_cast<const char*>(nullptr), ""}) {
    VLAnswer<VL_WS_StandardResponse> answer;
    EXPECT_EQ(VL_WS_E_INVALID_ARGUMENT,
              VL_WS_manageStreamingInstanceStatus(&m_Handle, stream, kPaused, 0, answer.Fresh()));
    EXPECT_EQ(VL_WS_TAG_STANDARD_RESPONSE, *answer->tag);
    EXPECT_EQ(0, answer->ResponseCode);
    EXPECT_EQ(nullptr, answer->ResponseMessage);
  }
  EXPECT_TRUE(RequestsNow().empty());
}

TEST_F(Streaming, RefusalFoldsIntoTheStatusOfLocationsNotOfTHX) {
  Init(DOWNLOAD);
  const int pass = Pass(10021);  // rented for 48 hours
  m_Sim.Store().AdvanceClock(49 * 3600);
  VLAnswer<VL_WS_StreamingAssetLocationResponse> location;
  EXPECT_EQ(VL_WS_E_UNEXPECTED, VL_WS_getStreamingAssetLocation(&m_Handle, pass, kStandard, location.Fresh()));
  m_Sim.Store().AdvanceClock(-49 * 3600);
  EXPECT_EQ(3, location->ResponseCode);
  EXPECT_STREQ("The rental has expired", location->ResponseMessage);
  EXPECT_STREQ("", location->StreamID);

  // A store's refusal stays in the record.
  VLAnswer<VL_WS_THXMediaDirectorResponse> thx;
  const int thxPass = Pass(10012);  // title 1001 has them
  ASSERT_EQ(VL_WS_OK, VL_WS_getTHXMediaDirector(&m_Handle, thxPass, kStandard, kDolbyPlus51, thx.Fresh()));
  EXPECT_EQ(0, thx->ResponseCode);
  EXPECT_STRNE("", thx->LongFormat);  // vlws_test's transcript has the settings of a bonus asset only
  EXPECT_STRNE("", thx->ShortFormat);
  Fault("getTHXMediaDirector=code:3,times=1");
  EXPECT_EQ(VL_WS_OK, VL_WS_getTHXMediaDirector(&m_Handle, thxPass, kStandard, kDolbyPlus51, thx.Fresh()));
  EXPECT_EQ(3, thx->ResponseCode);
  ASSERT_EQ(VL_WS_OK, Call(VL_WS_getTHXMediaDirectorBonusAsset, kBonusTrailer, kStandard, 0));

  Fault("getStreamingAssetLocation=soapfault");
  EXPECT_EQ(VL_WS_E_SOAP_FAULT(2), VL_WS_getStreamingAssetLocation(&m_Handle, pass, kStandard, location.Fresh()));
  EXPECT_EQ(nullptr, location->StreamingAssetLocation);
}

TEST_F(Streaming, DefaultAudioProfile) {
  Init(DOWNLOAD);
  ASSERT_EQ(VL_WS_OK, Call(VL_WS_setAudioDefaultProperty, kStereo));
  int profile = -1;
  ASSERT_EQ(VL_WS_OK, VL_WS_getAudioDefaultProperty(&m_Handle, &profile));
  EXPECT_EQ(kStereo, profile);
  Fault("setAudioDefaultProperty=code:4,times=1");
  VLAnswer<VL_WS_StandardResponse> answer;
  EXPECT_EQ(VL_WS_OK, VL_WS_setAudioDefaultProperty(&m_Handle, kDolbyPlus51, answer.Fresh()));
  EXPECT_EQ(4, answer->ResponseCode);
  EXPECT_EQ((std::vector<std::string>{"VL_WS_setAudioDefaultProperty, ret:0,responseCode:0",
                                      "VL_WS_getAudioDefaultProperty, ret:0,audioprofile:0",
                                      "VL_WS_setAudioDefaultProperty, ret:0,responseCode:4"}),
            TakeLog());
}

}  // namespace
