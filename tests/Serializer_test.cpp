// Serializer: real response records through compressed and plain XML, the in-memory transport,
// and cached values that are not what they should be; the memo of decoded answers that reads
// them back.
#include <gtest/gtest.h>

#include <memory>
#include <string>

#include "Serializer.h"
#include "VLAnswerMemo.h"

namespace {

std::string Str(const VLString& s) { return std::string(s.c_str(), s.length()); }

// One page of titles with everything a page can hold: products with decimal prices, file
// profiles and audio files, bonus assets as attributes, enumerations, texts needing escapes
// and bytes beyond ASCII. This is exactly how the serializer writes it, after the root element's
// namespace declarations.
const char kPage[] =
    "<VL1:getTitlesByNavigationResult><VL1:ResponseCode>0</VL1:ResponseCode>"
    "<VL1:ResponseMessage>OK &lt;all&gt; &amp; \"more\"</VL1:ResponseMessage><VL1:GenreID>17</VL1:GenreID>"
    "<VL1:CurrentPageNumber>2</VL1:CurrentPageNumber><VL1:ItemsPerPage>2</VL1:ItemsPerPage>"
    "<VL1:TotalPages>9</VL1:TotalPages><VL1:TotalItems>18</VL1:TotalItems><VL1:Titles>"
    "<VL1:TitleListing><VL1:TitleID>4711</VL1:TitleID><VL1:TitleName>Caf\xC3\xA9 M\xC3\xBCller \xE2\x98\x85"
    "</VL1:TitleName><VL1:BoxArtPrefix>cafe_mueller</VL1:BoxArtPrefix><VL1:TitlePosition>1</VL1:TitlePosition>"
    "<VL1:EpisodeNumber>0</VL1:EpisodeNumber><VL1:BonusAssets>"
    "<VL1:BonusAsset BonusAssetID=\"99\" Profile=\"HIGH_DEFINITION\" BonusType=\"Trailer\"></VL1:BonusAsset>"
    "</VL1:BonusAssets><VL1:IsTvListing>false</VL1:IsTvListing><VL1:MPAARating>PG-13</VL1:MPAARating>"
    "<VL1:AvailableProducts><VL1:ProductListing><VL1:SkuID>501</VL1:SkuID><VL1:PurchaseType>rent</VL1:PurchaseType>"
    "<VL1:Price>3.99</VL1:Price><VL1:AvailableAssets><VL1:FileProfile>STANDARD</VL1:FileProfile>"
    "<VL1:FileProfile>HIGH_DEFINITION_3D</VL1:FileProfile></VL1:AvailableAssets><VL1:AvailableAudioProfiles>"
    "<VL1:AudioFile><VL1:AssetAudioID>7</VL1:AssetAudioID><VL1:FileLocation>http://cdn/a.ac3?x=1&amp;y=2"
    "</VL1:FileLocation><VL1:ContainsVideo>true</VL1:ContainsVideo>"
    "<VL1:AudioAssetProfile>Dolby_Digital_Plus_51</VL1:AudioAssetProfile></VL1:AudioFile>"
    "</VL1:AvailableAudioProfiles><VL1:RentalPeriod>48</VL1:RentalPeriod></VL1:ProductListing>"
    "<VL1:ProductListing><VL1:SkuID>502</VL1:SkuID><VL1:PurchaseType>buy</VL1:PurchaseType>"
    "<VL1:Price>14.990</VL1:Price><VL1:ExpireDate>2031-01-01</VL1:ExpireDate><VL1:RentalPeriod>0</VL1:RentalPeriod>"
    "</VL1:ProductListing></VL1:AvailableProducts><VL1:IsTHXMediaDirectorEnabled>true</VL1:IsTHXMediaDirectorEnabled>"
    "<VL1:IsTHXMediaDirectorEnabledForTrailer>false</VL1:IsTHXMediaDirectorEnabledForTrailer></VL1:TitleListing>"
    "<VL1:TitleListing><VL1:TitleID>4712</VL1:TitleID><VL1:TitleName>Pilot</VL1:TitleName>"
    "<VL1:TitlePosition>2</VL1:TitlePosition><VL1:EpisodeNumber>1</VL1:EpisodeNumber>"
    "<VL1:IsTvListing>true</VL1:IsTvListing><VL1:IsTHXMediaDirectorEnabled>false</VL1:IsTHXMediaDirectorEnabled>"
    "<VL1:IsTHXMediaDirectorEnabledForTrailer>false</VL1:IsTHXMediaDirectorEnabledForTrailer></VL1:TitleListing>"
    "</VL1:Titles></VL1:getTitlesByNavigationResult></DUDUVud>";

// The plain text the serializer writes for record.
template <class T>
std::string Written(const T& record) {
  std::unique_ptr<Serializer> writer(new Serializer(false, false));
  EXPECT_EQ(SOAP_OK, writer->Put(record));
  return Str(writer->GetXML());
}

// The text of record after the root element's start tag: kPage when it is the page, whole.
template <class T>
std::string Content(const T& record) {
  std::string text = Written(record);
  return text.substr(text.find('>', text.find("<DUDUVud")) + 1);
}

// A context standing in for a service proxy, and a memo that reads stored values back.
class SerializerTest : public ::testing::Test {
 protected:
  SerializerTest() : m_Owner(soap_new()) {}
  ~SerializerTest() override {
    soap_destroy(m_Owner);
    soap_end(m_Owner);
    soap_free(m_Owner);
  }

  // The record the memo has for value, or null when value does not decode.
  const _VL1__getTitlesByNavigationResponse* Load(const VLString& value) {
    const _VL1__getTitlesByNavigationResponse* page = nullptr;
    m_Memo.Use("getTitles", "1,1,2,2", value, soap_new__VL1__getTitlesByNavigationResponse,
               [&](const _VL1__getTitlesByNavigationResponse& read) {
                 page = &read;
                 return true;
               });
    return page;
  }

  // The page, read from its text.
  const _VL1__getTitlesByNavigationResponse* Page() {
    std::string text = std::string("<DUDUVud xmlns:VL1=\"http://store.ostrel.example/api/\">") + kPage;
    const _VL1__getTitlesByNavigationResponse* page = Load(VLString(text.c_str()));
    EXPECT_NE(nullptr, page);
    return page;
  }

  struct soap* m_Owner;
  VLAnswerMemo m_Memo;
};

TEST_F(SerializerTest, PlainOutputIsTheWholePageWithoutEncodingStyleOrIndent) {
  const _VL1__getTitlesByNavigationResponse* page = Page();
  const VL1__TitleListing* movie = page->getTitlesByNavigationResult->Titles->TitleListing[0];
  EXPECT_STREQ("Caf\xC3\xA9 M\xC3\xBCller \xE2\x98\x85", movie->TitleName);
  EXPECT_EQ(VL1__FileProfile__HIGH_USCOREDEFINITION, movie->BonusAssets->BonusAsset[0]->Profile);
  EXPECT_EQ(VL1__FileProfile__HIGH_USCOREDEFINITION_USCORE3D,
            movie->AvailableProducts->ProductListing[0]->AvailableAssets->FileProfile[1]);
  EXPECT_STREQ("14.990", movie->AvailableProducts->ProductListing[1]->Price);  // decimal text as written

  std::string text = Written(*page);
  EXPECT_EQ(0u, text.find("<?xml")) << text;
  EXPECT_NE(std::string::npos, text.find("<DUDUVud xmlns:SOAP-ENV=")) << text;
  EXPECT_EQ(std::string::npos, text.find("encodingStyle")) << text;
  EXPECT_EQ(kPage, Content(*page));
}

// The memo decodes a text once; another text under the same name and key is decoded anew, and a
// record kept from a service context answers its stored text after that context let go of it.
TEST_F(SerializerTest, StoredResponseIsGzipAndTheMemoDecodesEachTextOnce) {
  VLString value;
  ASSERT_TRUE(StoreResponse(*Page(), value, true));
  ASSERT_GT(value.length(), 18u);
  EXPECT_EQ('\x1F', value[0]);
  EXPECT_EQ('\x8B', value[1]);
  const _VL1__getTitlesByNavigationResponse* loaded = Load(value);
  ASSERT_NE(nullptr, loaded);
  EXPECT_EQ(kPage, Content(*loaded));
  EXPECT_EQ(loaded, Load(value));

  VLString plain;
  ASSERT_TRUE(StoreResponse(*loaded, plain, false));
  EXPECT_EQ(0u, Str(plain).find("<?xml"));
  const _VL1__getTitlesByNavigationResponse* other = Load(plain);
  EXPECT_NE(loaded, other);
  EXPECT_EQ(kPage, Content(*other));

  auto* fresh = soap_new__VL1__getTitlesByNavigationResponse(m_Owner);
  fresh->getTitlesByNavigationResult = soap_new_VL1__GetTitlesResponse(m_Owner);
  fresh->getTitlesByNavigationResult->TotalItems = 7;
  VLString stored;
  ASSERT_TRUE(StoreResponse(*fresh, stored, true));
  m_Memo.Keep("getTitles", "1,1,2,2", stored, fresh, m_Owner);
  soap_destroy(m_Owner);
  soap_end(m_Owner);
  const _VL1__getTitlesByNavigationResponse* kept = Load(stored);
  EXPECT_EQ(fresh, kept);
  EXPECT_EQ(7, kept->getTitlesByNavigationResult->TotalItems);
}

TEST_F(SerializerTest, EveryReaderReadsCompressedAndPlainValues) {
  for (bool compress : {true, false}) {
    std::unique_ptr<Serializer> writer(new Serializer(compress, false));
    ASSERT_EQ(SOAP_OK, writer->Put(*Page()));
    for (bool readerCompresses : {true, false}) {
      SCOPED_TRACE(testing::Message() << "written compressed " << compress << ", reader compresses "
                                      << readerCompresses);
      std::unique_ptr<Serializer> reader(new Serializer(readerCompresses, false));
      reader->SetXML(writer->GetXML());
      _VL1__getTitlesByNavigationResponse page;
      ASSERT_EQ(SOAP_OK, reader->Get(page));
      EXPECT_EQ(kPage, Content(page));
    }
  }
}

// An empty page is written as an empty array, not left out; indented output reads back too.
TEST_F(SerializerTest, IndentedOutputAndEmptyArrays) {
  VL1__GetTitlesResponse empty;
  empty.Titles = soap_new_VL1__ArrayOfTitleListing(m_Owner);
  std::unique_ptr<Serializer> writer(new Serializer(false, true));
  ASSERT_EQ(SOAP_OK, writer->Put(empty));
  EXPECT_NE(std::string::npos, Str(writer->GetXML()).find("\n\t<VL1:ResponseCode>0</VL1:ResponseCode>"));
  std::unique_ptr<Serializer> reader(new Serializer(false, false));
  reader->SetXML(writer->GetXML());
  VL1__GetTitlesResponse read;
  ASSERT_EQ(SOAP_OK, reader->Get(read));
  ASSERT_NE(nullptr, read.Titles);
  EXPECT_EQ(0, read.Titles->__sizeTitleListing);
}

TEST_F(SerializerTest, DamagedCachedValuesLoadAsMisses) {
  VLString good;
  ASSERT_TRUE(StoreResponse(*Page(), good, true));
  std::string xml = Written(*Page());

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
    EXPECT_EQ(nullptr, Load(VLString(value.data(), value.size())));
  }

  // A well-formed value whose record has no result element loads, and the caller sees the miss.
  VLString noResult;
  ASSERT_TRUE(StoreResponse(_VL1__getTitlesByNavigationResponse(), noResult, true));
  const _VL1__getTitlesByNavigationResponse* page = Load(noResult);
  ASSERT_NE(nullptr, page);
  EXPECT_EQ(nullptr, page->getTitlesByNavigationResult);
}

}  // namespace
