// Serializer: real response records through compressed and plain XML, the in-memory transport,
// and cached values that are not what they should be.
#include <gtest/gtest.h>

#include <memory>
#include <string>

#include "Serializer.h"

namespace {

std::string Str(const VLString& s) { return std::string(s.c_str(), s.length()); }

// A context standing in for a service proxy: the owner of records and of loaded answers.
class SerializerTest : public ::testing::Test {
 protected:
  SerializerTest() : m_Owner(soap_new()) {}
  ~SerializerTest() override {
    soap_destroy(m_Owner);
    soap_end(m_Owner);
    soap_free(m_Owner);
  }

  char* Text(const char* s) { return soap_strdup(m_Owner, s); }

  // n new items of a record array, made by the generated allocator make.
  template <class Item>
  Item** Items(int n, Item* (*make)(struct soap*, int)) {
    Item** items = static_cast<Item**>(soap_malloc(m_Owner, n * sizeof(Item*)));
    for (int i = 0; i < n; ++i) items[i] = make(m_Owner, -1);
    return items;
  }

  // One page of titles with everything a page can hold: products with decimal prices, file
  // profiles and audio files, bonus assets as attributes, enumerations, texts needing escapes
  // and bytes beyond ASCII.
  _VL1__getTitlesByNavigationResponse* TitlesPage() {
    auto* page = soap_new__VL1__getTitlesByNavigationResponse(m_Owner);
    auto* result = page->getTitlesByNavigationResult = soap_new_VL1__GetTitlesResponse(m_Owner);
    result->ResponseCode = 0;
    result->ResponseMessage = Text("OK <all> & \"more\"");
    result->GenreID = 17;
    result->CurrentPageNumber = 2;
    result->ItemsPerPage = 2;
    result->TotalPages = 9;
    result->TotalItems = 18;
    result->Titles = soap_new_VL1__ArrayOfTitleListing(m_Owner);
    result->Titles->__sizeTitleListing = 2;
    result->Titles->TitleListing = Items(2, soap_new_VL1__TitleListing);

    VL1__TitleListing* movie = result->Titles->TitleListing[0];
    movie->TitleID = 4711;
    movie->TitleName = Text("Caf\xC3\xA9 M\xC3\xBCller \xE2\x98\x85");  // UTF-8 bytes
    movie->BoxArtPrefix = Text("cafe_mueller");
    movie->TitlePosition = 1;
    movie->IsTvListing = false_;
    movie->MPAARating = Text("PG-13");
    movie->IsTHXMediaDirectorEnabled = true_;
    movie->BonusAssets = soap_new_VL1__ArrayOfBonusAsset(m_Owner);
    movie->BonusAssets->__sizeBonusAsset = 1;
    movie->BonusAssets->BonusAsset = Items(1, soap_new_VL1__BonusAsset);
    movie->BonusAssets->BonusAsset[0]->BonusAssetID = 99;
    movie->BonusAssets->BonusAsset[0]->Profile = VL1__FileProfile__HIGH_USCOREDEFINITION;
    movie->BonusAssets->BonusAsset[0]->BonusType = VL1__BonusAssetType__Trailer;
    movie->AvailableProducts = soap_new_VL1__ArrayOfProductListing(m_Owner);
    movie->AvailableProducts->__sizeProductListing = 2;
    movie->AvailableProducts->ProductListing = Items(2, soap_new_VL1__ProductListing);
    VL1__ProductListing* rent = movie->AvailableProducts->ProductListing[0];
    rent->SkuID = 501;
    rent->PurchaseType = VL1__StreamAPIPurchaseType__rent;
    rent->Price = Text("3.99");
    rent->RentalPeriod = 48;
    rent->AvailableAssets = soap_new_VL1__ArrayOfFileProfile(m_Owner);
    rent->AvailableAssets->__sizeFileProfile = 2;
    rent->AvailableAssets->FileProfile =
        static_cast<VL1__FileProfile*>(soap_malloc(m_Owner, 2 * sizeof(VL1__FileProfile)));
    rent->AvailableAssets->FileProfile[0] = VL1__FileProfile__STANDARD;
    rent->AvailableAssets->FileProfile[1] = VL1__FileProfile__HIGH_USCOREDEFINITION_USCORE3D;
    rent->AvailableAudioProfiles = soap_new_VL1__ArrayOfAudioFile(m_Owner);
    rent->AvailableAudioProfiles->__sizeAudioFile = 1;
    rent->AvailableAudioProfiles->AudioFile = Items(1, soap_new_VL1__AudioFile);
    rent->AvailableAudioProfiles->AudioFile[0]->AssetAudioID = 7;
    rent->AvailableAudioProfiles->AudioFile[0]->FileLocation = Text("http://cdn/a.ac3?x=1&y=2");
    rent->AvailableAudioProfiles->AudioFile[0]->ContainsVideo = true_;
    rent->AvailableAudioProfiles->AudioFile[0]->AudioAssetProfile =
        VL1__AudioProfile__Dolby_USCOREDigital_USCOREPlus_USCORE51;
    VL1__ProductListing* buy = movie->AvailableProducts->ProductListing[1];
    buy->SkuID = 502;
    buy->PurchaseType = VL1__StreamAPIPurchaseType__buy;
    buy->Price = Text("14.990");  // decimal text is kept as written
    buy->ExpireDate = Text("2031-01-01");

    VL1__TitleListing* episode = result->Titles->TitleListing[1];
    episode->TitleID = 4712;
    episode->TitleName = Text("Pilot");
    episode->EpisodeNumber = 1;
    episode->IsTvListing = true_;
    episode->TitlePosition = 2;
    return page;
  }

  static void ExpectTitlesPage(const _VL1__getTitlesByNavigationResponse& page) {
    const VL1__GetTitlesResponse* result = page.getTitlesByNavigationResult;
    ASSERT_NE(nullptr, result);
    EXPECT_EQ(0, result->ResponseCode);
    EXPECT_STREQ("OK <all> & \"more\"", result->ResponseMessage);
    EXPECT_EQ(17, result->GenreID);
    EXPECT_EQ(2, result->CurrentPageNumber);
    EXPECT_EQ(2, result->ItemsPerPage);
    EXPECT_EQ(9, result->TotalPages);
    EXPECT_EQ(18, result->TotalItems);
    ASSERT_NE(nullptr, result->Titles);
    ASSERT_EQ(2, result->Titles->__sizeTitleListing);

    const VL1__TitleListing* movie = result->Titles->TitleListing[0];
    EXPECT_EQ(4711, movie->TitleID);
    EXPECT_STREQ("Caf\xC3\xA9 M\xC3\xBCller \xE2\x98\x85", movie->TitleName);
    EXPECT_STREQ("cafe_mueller", movie->BoxArtPrefix);
    EXPECT_EQ(false_, movie->IsTvListing);
    EXPECT_EQ(true_, movie->IsTHXMediaDirectorEnabled);
    EXPECT_EQ(false_, movie->IsTHXMediaDirectorEnabledForTrailer);
    EXPECT_EQ(nullptr, movie->CHVRSRating);
    ASSERT_NE(nullptr, movie->BonusAssets);
    ASSERT_EQ(1, movie->BonusAssets->__sizeBonusAsset);
    EXPECT_EQ(99, movie->BonusAssets->BonusAsset[0]->BonusAssetID);
    EXPECT_EQ(VL1__FileProfile__HIGH_USCOREDEFINITION, movie->BonusAssets->BonusAsset[0]->Profile);
    ASSERT_NE(nullptr, movie->AvailableProducts);
    ASSERT_EQ(2, movie->AvailableProducts->__sizeProductListing);
    const VL1__ProductListing* rent = movie->AvailableProducts->ProductListing[0];
    EXPECT_EQ(501, rent->SkuID);
    EXPECT_EQ(VL1__StreamAPIPurchaseType__rent, rent->PurchaseType);
    EXPECT_STREQ("3.99", rent->Price);
    EXPECT_EQ(48, rent->RentalPeriod);
    ASSERT_NE(nullptr, rent->AvailableAssets);
    ASSERT_EQ(2, rent->AvailableAssets->__sizeFileProfile);
    EXPECT_EQ(VL1__FileProfile__STANDARD, rent->AvailableAssets->FileProfile[0]);
    EXPECT_EQ(VL1__FileProfile__HIGH_USCOREDEFINITION_USCORE3D,
              rent->AvailableAssets->FileProfile[1]);
    ASSERT_NE(nullptr, rent->AvailableAudioProfiles);
    ASSERT_EQ(1, rent->AvailableAudioProfiles->__sizeAudioFile);
    const VL1__AudioFile* audio = rent->AvailableAudioProfiles->AudioFile[0];
    EXPECT_EQ(7, audio->AssetAudioID);
    EXPECT_STREQ("http://cdn/a.ac3?x=1&y=2", audio->FileLocation);
    EXPECT_EQ(true_, audio->ContainsVideo);
    EXPECT_EQ(VL1__AudioProfile__Dolby_USCOREDigital_USCOREPlus_USCORE51, audio->AudioAssetProfile);
    const VL1__ProductListing* buy = movie->AvailableProducts->ProductListing[1];
    EXPECT_EQ(VL1__StreamAPIPurchaseType__buy, buy->PurchaseType);
    EXPECT_STREQ("14.990", buy->Price);
    EXPECT_STREQ("2031-01-01", buy->ExpireDate);
    EXPECT_EQ(nullptr, buy->AvailableAssets);

    const VL1__TitleListing* episode = result->Titles->TitleListing[1];
    EXPECT_EQ(4712, episode->TitleID);
    EXPECT_EQ(1, episode->EpisodeNumber);
    EXPECT_EQ(true_, episode->IsTvListing);
    EXPECT_EQ(nullptr, episode->BonusAssets);
  }

  struct soap* m_Owner;
};

TEST_F(SerializerTest, StoredResponseIsGzipAndLoadsBackIntoTheOwnersMemory) {
  VLString value;
  ASSERT_TRUE(StoreResponse(*TitlesPage(), value));
  ASSERT_GT(value.length(), 18u);
  EXPECT_EQ('\x1F', value[0]);
  EXPECT_EQ('\x8B', value[1]);

  auto* loaded = soap_new__VL1__getTitlesByNavigationResponse(m_Owner);
  ASSERT_TRUE(LoadResponse(value, *loaded, m_Owner));
  ExpectTitlesPage(*loaded);
  // The loaded answer outlives the serializer that read it; the owner releases it (the leak
  // check of the sanitizer build sees that nothing stays behind).
}

TEST_F(SerializerTest, EveryReaderReadsCompressedAndPlainValues) {
  for (bool compress : {true, false}) {
    std::unique_ptr<Serializer> writer(new Serializer(compress, false));
    ASSERT_EQ(SOAP_OK, writer->Put(*TitlesPage()));
    VLString value = writer->GetXML();
    if (!compress) {
      std::string text = Str(value);
      EXPECT_EQ(0u, text.find("<?xml")) << text;
      EXPECT_NE(std::string::npos, text.find("<DUDUVud xmlns:SOAP-ENV=")) << text;
      EXPECT_NE(std::string::npos, text.find("<VL1:Price>3.99</VL1:Price>")) << text;
      EXPECT_NE(std::string::npos, text.find("<VL1:PurchaseType>rent</VL1:PurchaseType>")) << text;
      EXPECT_NE(std::string::npos, text.find("Profile=\"HIGH_DEFINITION\"")) << text;
      EXPECT_EQ(std::string::npos, text.find("encodingStyle")) << text;
      EXPECT_EQ(std::string::npos, text.find("\n\t")) << "not indented";
    }
    for (bool readerCompresses : {true, false}) {
      SCOPED_TRACE(testing::Message() << "written compressed " << compress << ", reader compresses "
                                      << readerCompresses);
      std::unique_ptr<Serializer> reader(new Serializer(readerCompresses, false));
      reader->SetXML(value);
      _VL1__getTitlesByNavigationResponse page;
      ASSERT_EQ(SOAP_OK, reader->Get(page));
      ExpectTitlesPage(page);
    }
  }
}

TEST_F(SerializerTest, IndentedOutputAndEmptyArrays) {
  VL1__GetTitlesResponse empty;
  empty.Titles = soap_new_VL1__ArrayOfTitleListing(m_Owner);  // an empty page, not a missing one
  std::unique_ptr<Serializer> writer(new Serializer(false, true));
  ASSERT_EQ(SOAP_OK, writer->Put(empty));
  std::string text = Str(writer->GetXML());
  EXPECT_NE(std::string::npos, text.find("\n\t<VL1:ResponseCode>0</VL1:ResponseCode>")) << text;

  std::unique_ptr<Serializer> reader(new Serializer(false, false));
  reader->SetXML(writer->GetXML());
  VL1__GetTitlesResponse read;
  ASSERT_EQ(SOAP_OK, reader->Get(read));
  ASSERT_NE(nullptr, read.Titles);
  EXPECT_EQ(0, read.Titles->__sizeTitleListing);
  EXPECT_EQ(nullptr, read.ResponseMessage);
}

TEST_F(SerializerTest, ReceiveCallbackHandsOutTheBufferFromTheFront) {
  std::unique_ptr<Serializer> serializer(new Serializer(false, false));
  serializer->SetXML(VLString("ab\0d", 4));
  char buf[10];
  EXPECT_EQ(0u, Serializer::Serializer_frecv(serializer.get(), buf, 0));
  EXPECT_EQ(2u, Serializer::Serializer_frecv(serializer.get(), buf, 2));
  EXPECT_EQ("ab", std::string(buf, 2));
  EXPECT_EQ(2u, Serializer::Serializer_frecv(serializer.get(), buf, 10));
  EXPECT_EQ(std::string("\0d", 2), std::string(buf, 2));
  EXPECT_EQ(0u, Serializer::Serializer_frecv(serializer.get(), buf, 10));
  EXPECT_TRUE(serializer->GetXML().empty());

  serializer->SetXML(VLString("abcd"));
  EXPECT_EQ(4u, Serializer::Serializer_frecv(serializer.get(), buf, 10));
  EXPECT_EQ(0u, Serializer::Serializer_frecv(serializer.get(), buf, 10));

  EXPECT_EQ(SOAP_OK, Serializer::Serializer_fsend(serializer.get(), "x\0y", 3));
  EXPECT_EQ(SOAP_OK, Serializer::Serializer_fsend(serializer.get(), "z", 1));
  EXPECT_EQ(std::string("x\0yz", 4), Str(serializer->GetXML()));
}

TEST_F(SerializerTest, CallbacksOnAContextThatIsNoSerializerStop) {
  char buf[4];
  EXPECT_DEATH(Serializer::Serializer_fsend(m_Owner, "x", 1), "pSerializer != 0");
  EXPECT_DEATH(Serializer::Serializer_frecv(m_Owner, buf, 4), "pSerializer != 0");
}

TEST_F(SerializerTest, DamagedCachedValuesLoadAsMisses) {
  VLString good;
  ASSERT_TRUE(StoreResponse(*TitlesPage(), good));
  std::unique_ptr<Serializer> plain(new Serializer(false, false));
  ASSERT_EQ(SOAP_OK, plain->Put(*TitlesPage()));
  std::string xml = Str(plain->GetXML());

  std::string corrupt = Str(good);
  corrupt[corrupt.size() / 2] ^= 0x55;
  std::string wrongCrc = Str(good);
  wrongCrc[wrongCrc.size() - 6] ^= 0x01;
  std::string otherRoot = xml;
  otherRoot.replace(otherRoot.find("<DUDUVud"), 8, "<Elsewhere");
  const std::string values[] = {
      std::string(),
      "not xml at all",
      std::string("\x1F\x8B\x08\x00garbage that is no deflate data", 36),
      Str(good).substr(0, good.length() / 2),  // cut short
      corrupt,
      wrongCrc,
      xml.substr(0, xml.size() / 2),
      otherRoot,
      std::string(4096, '\0'),
  };
  for (const std::string& value : values) {
    SCOPED_TRACE(testing::Message() << "value of " << value.size() << " bytes");
    auto* page = soap_new__VL1__getTitlesByNavigationResponse(m_Owner);
    EXPECT_FALSE(LoadResponse(VLString(value.data(), value.size()), *page, m_Owner));
    EXPECT_EQ(nullptr, page->getTitlesByNavigationResult);  // the caller's miss rule
  }

  // A well-formed value whose record has no result element loads, and the caller sees the miss.
  VLString noResult;
  ASSERT_TRUE(StoreResponse(_VL1__getTitlesByNavigationResponse(), noResult));
  auto* page = soap_new__VL1__getTitlesByNavigationResponse(m_Owner);
  EXPECT_TRUE(LoadResponse(noResult, *page, m_Owner));
  EXPECT_EQ(nullptr, page->getTitlesByNavigationResult);
}

}  // namespace
