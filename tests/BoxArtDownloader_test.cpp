// BoxArtDownloader against a canned image host (a loopback server that plays one answer per
// connection): the request it sends, how it reads answers, and what it leaves on disk.
#include <gtest/gtest.h>
#include <sys/stat.h>

#include <set>
#include <string>

#include "BoxArtDownloader.h"
#include "RealTimeBrowse.h"
#include "VLStoreHosts.h"
#include "VLTestDir.h"
#include "VLTestServer.h"

namespace {

// A complete answer of the image host.
std::string Ok(const std::string& body, const std::string& headers = "") {
  return VLTestServer::HttpReply(body, "200 OK", headers);
}

// Bytes of every value, zeros included, as an image has them, between the markers that begin
// and end a JPEG image (size at least 5).
std::string Image(size_t size) {
  std::string data(size, '\0');
  for (size_t i = 0; i < size; ++i) data[i] = static_cast<char>(i * 7 % 256);
  return data.replace(0, 3, "\xFF\xD8\xFF").replace(size - 2, 2, "\xFF\xD9");
}

const std::string kTiny = Image(8);

const char kLastModified[] = "Mon, 03 Jan 2011 10:00:00 GMT";

class BoxArtDownloaderTest : public testing::Test {
 protected:
  BoxArtDownloaderTest() : m_Downloader(&m_Context) { m_Context.recv_timeout = 5; }

  VL_WS_Status Get(const std::string& reply, std::string* data = nullptr, const char* since = "") {
    m_Host.SetReply(reply);
    VLString bytes("garbage");
    VL_WS_Status status = m_Downloader.DownloadToBuffer("t1001_", VL_WS_BOXART_175, since, bytes);
    if (data) *data = std::string(bytes.c_str(), bytes.length());
    return status;
  }
  VL_WS_Status GetFile(const std::string& reply, const std::string& file) {
    m_Host.SetReply(reply);
    return m_Downloader.DownloadToFile("t1001_", VL_WS_BOXART_175, "", file.c_str());
  }
  std::string LastRequest() { return m_Host.Requests().empty() ? "" : m_Host.Requests().back(); }

  VLTestServer& m_Host = VLStandInServer(VL_STORE_IMAGE_HOST, 80);
  RealTimeBrowse m_Context;  // a catalogue context: the library's transport and time-outs
  BoxArtDownloader m_Downloader;
};

TEST_F(BoxArtDownloaderTest, SendsAHandBuiltGetConditionalWhenAsked) {
  VLString data;
  m_Host.SetReply(Ok(kTiny));
  ASSERT_EQ(VL_WS_OK, m_Downloader.DownloadToBuffer("night owl_", VL_WS_BOXART_135S, "", data));
  EXPECT_EQ(
      "GET /images/boxart/135s/night%20owl_135.jpg HTTP/1.1\r\n"
      "User-Agent: DUDUVud\r\nHost: images.ostrel.example\r\n\r\n",
      LastRequest());
  ASSERT_EQ(VL_WS_OK, m_Downloader.DownloadToBuffer("t1001_", VL_WS_BOXART_321, kLastModified, data));
  EXPECT_EQ(std::string("GET /images/boxart/321/t1001_321.jpg HTTP/1.1\r\nIf-Modified-Since: ") + kLastModified +
                "\r\nUser-Agent: DUDUVud\r\nHost: images.ostrel.example\r\n\r\n",
            LastRequest());
}

TEST_F(BoxArtDownloaderTest, ReadsTheImageAndItsValidators) {
  std::string image = Image(10000), data;  // several receives after the first piece
  ASSERT_EQ(VL_WS_OK, Get(Ok(image, std::string("Last-Modified: ") + kLastModified + "\r\n"), &data));
  EXPECT_EQ(image, data);
  EXPECT_EQ(10000u, m_Downloader.GetContentLength());
  EXPECT_EQ(kLastModified, m_Downloader.GetLastModified());

  // Each download starts afresh: no "Last-Modified" gives none, a failure gives 0.
  ASSERT_EQ(VL_WS_OK, Get(Ok(kTiny), &data));
  EXPECT_EQ(kTiny, data);
  EXPECT_TRUE(m_Downloader.GetLastModified().empty());
  EXPECT_EQ(VL_WS_E_NETWORK, Get(""));
  EXPECT_EQ(0u, m_Downloader.GetContentLength());
}

// Anything but a complete image fails and leaves no bytes. (VLHttpGet's own tests have every
// form of answer it does not take; here are the downloader's own statuses and checks.)
TEST_F(BoxArtDownloaderTest, AnswersOtherThanACompleteImageFail) {
  const struct {
    std::string reply;
    VL_WS_Status status;
  } cases[] = {
      {"HTTP/1.1 404 Not Found\r\nContent-Length: 3\r\n\r\nno!", VL_WS_E_HTTP_NOT_FOUND},
      {std::string("HTTP/1.1 304 Not Modified\r\nLast-Modified: ") + kLastModified + "\r\n\r\n",
       VL_WS_E_HTTP_NOT_MODIFIED},
      {"HTTP/1.1 200 OK\r\nContent-Length: 100\r\n\r\nshort", VL_WS_E_NETWORK},
      {"HTTP/1.1 200 OK\r\nContent-Length: 33554433\r\n\r\nabc", VL_WS_E_NETWORK},  // above 32 MiB
  };
  for (const auto& c : cases) {
    SCOPED_TRACE(c.reply.substr(0, 80));
    std::string data;
    EXPECT_EQ(c.status, Get(c.reply, &data));
    EXPECT_EQ("", data);
  }
}

TEST_F(BoxArtDownloaderTest, FileIsReplacedOnlyByACompleteImage) {
  VLTestDir dir;
  std::string file = dir / "t1001_175.jpg";
  ASSERT_TRUE(VLWriteFile(file, "old"));
  std::string image = Image(5000);
  ASSERT_EQ(VL_WS_OK, GetFile(Ok(image), file));
  EXPECT_EQ(image, VLReadFile(file));
  EXPECT_EQ(std::set<std::string>{"t1001_175.jpg"}, VLFolderFiles(dir.path()));

  const char* failures[] = {
      "HTTP/1.1 304 Not Modified\r\n\r\n",
      "HTTP/1.1 200 OK\r\nContent-Length: 100000\r\n\r\nonly the start",
      "HTTP/1.1 200 OK\r\nContent-Length: 33554433\r\n\r\nabc",
  };
  for (const char* reply : failures) {
    SCOPED_TRACE(reply);
    EXPECT_NE(VL_WS_OK, GetFile(reply, file));
    EXPECT_EQ(image, VLReadFile(file));
    EXPECT_EQ(std::set<std::string>{"t1001_175.jpg"}, VLFolderFiles(dir.path()));
  }
  // A new file appears only when complete.
  std::string fresh = dir / "t1001_95.jpg";
  EXPECT_EQ(VL_WS_E_NETWORK, GetFile("HTTP/1.1 200 OK\r\nContent-Length: 10\r\n\r\nabc", fresh));
  EXPECT_EQ(std::set<std::string>{"t1001_175.jpg"}, VLFolderFiles(dir.path()));
}

TEST_F(BoxArtDownloaderTest, FileThatCannotBeWrittenEndsWithAFileError) {
  VLTestDir dir;
  // No temporary file in a missing folder: nothing is asked of the host.
  size_t asked = m_Host.Requests().size();
  EXPECT_EQ(VL_WS_E_FILE, GetFile(Ok(kTiny), dir / "missing/t1001_175.jpg"));
  EXPECT_EQ(asked, m_Host.Requests().size());

  // A folder with content in the destination's place cannot be replaced.
  std::string blocked = dir / "t1001_175.jpg";
  ASSERT_EQ(0, mkdir(blocked.c_str(), 0755));
  ASSERT_TRUE(VLWriteFile(blocked + "/keep", "x"));
  EXPECT_EQ(VL_WS_E_FILE, GetFile(Ok(kTiny), blocked));
  EXPECT_EQ(std::set<std::string>{"t1001_175.jpg"}, VLFolderFiles(dir.path()));
}

TEST_F(BoxArtDownloaderTest, UnreachableHostEndsWithAConnectionError) {
  VLTestDir dir;
  // The host is reached through a proxy here, so that the connection can fail.
  m_Context.proxy_host = "127.0.0.1";
  m_Context.proxy_port = VLClosedPort();
  std::string data;
  EXPECT_EQ(VL_WS_E_CONNECT, Get(Ok(kTiny), &data));
  EXPECT_EQ(VL_WS_E_CONNECT, GetFile(Ok(kTiny), dir / "t1001_175.jpg"));
  EXPECT_TRUE(VLFolderFiles(dir.path()).empty());
  m_Context.proxy_host = nullptr;
}

}  // namespace
