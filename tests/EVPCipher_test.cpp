// EVPCipher: the text encoding, key and IV derivation, and both ciphers, pinned against cipher
// texts computed independently with the openssl command-line tool.
#include <gtest/gtest.h>

#include <openssl/err.h>
#include <openssl/evp.h>
#include <string.h>

#include <string>

#include "EVPCipher.h"

namespace {

std::string Str(const VLString& s) { return std::string(s.c_str(), s.length()); }

// Key bytes 00 11 22 ... ff; the IV is each key byte AND 0xB7.
const char kPassword[] = "00112233445566778899aabbccddeeff";

TEST(EVPCipher, TextEncoding) {
  const unsigned char bytes[] = {0x01, 0x23, 0x45, 0x67, 0x89, 0xAB, 0xCD, 0xEF, 0x00, 0xFF};
  VLString text = EVPCipher::SimpleEncode(bytes, sizeof bytes);
  EXPECT_EQ("0123456789abcdef00ff", Str(text));  // the alphabet, fixed forever

  unsigned n = 0;
  EXPECT_TRUE(EVPCipher::SimpleDecode(text, NULL, n));
  EXPECT_EQ(10u, n);
  unsigned char out[16];
  n = sizeof out;
  ASSERT_TRUE(EVPCipher::SimpleDecode(text, out, n));
  ASSERT_EQ(10u, n);
  EXPECT_EQ(0, memcmp(bytes, out, 10));

  n = 9;  // one byte too small
  EXPECT_FALSE(EVPCipher::SimpleDecode(text, out, n));
  n = sizeof out;
  EXPECT_FALSE(EVPCipher::SimpleDecode(VLString("abc"), out, n));
  for (const char* bad : {"0g", "0A", "z0", "0 ", "0\xff"}) {
    n = sizeof out;
    EXPECT_FALSE(EVPCipher::SimpleDecode(VLString(bad), out, n)) << bad;
  }
  n = sizeof out;
  EXPECT_FALSE(EVPCipher::SimpleDecode(VLString("0\0", 2), out, n));
}

// Blowfish comes from a library context of the cipher's own: the host process's OpenSSL still
// has no legacy provider afterwards.
TEST(EVPCipher, PinnedCipherTextsAndTheHostsOpenSSLLeftAlone) {
  const struct {
    EVPCipher::ALGO algo;
    const char* encrypted;
  } pinned[] = {
      // printf 'Hello, settings!' |
      //   openssl enc -aes-128-cbc -K <key> -iv 00112233041526378091a2b38495a6b7
      {EVPCipher::AES_128_CBC, "f5428afa08589ad17e94d42d83a2e98f73f3b8d9cb139bfbbcc07cde67973e04"},
      // ... | openssl enc -bf-cbc -provider legacy -provider default -K <key> -iv 0011223304152637
      {EVPCipher::BLOWFISH_CBC, "ab2c0cfbedd44c27d7d993fbb97ad3ab2d657df3afa73c9c"},
  };
  for (const auto& p : pinned) {
    EVPCipher cipher(p.algo);
    EXPECT_EQ(p.encrypted, Str(cipher.Encrypt("Hello, settings!", kPassword)));
    EXPECT_EQ("Hello, settings!", Str(cipher.Decrypt(p.encrypted, kPassword)));
  }
  EVP_CIPHER* global = EVP_CIPHER_fetch(NULL, "BF-CBC", NULL);
  EXPECT_EQ(nullptr, global);
  EVP_CIPHER_free(global);
}

TEST(EVPCipher, BothCiphersRoundTrip) {
  struct Case {
    EVPCipher::ALGO algo;
    unsigned block;
  };
  for (Case c : {Case{EVPCipher::AES_128_CBC, 16}, Case{EVPCipher::BLOWFISH_CBC, 8}}) {
    SCOPED_TRACE(testing::Message() << "algorithm " << c.algo);
    EVPCipher cipher(c.algo);
    EXPECT_EQ(32u, cipher.PasswordLength());
    VLString first = cipher.GeneratePswd(), second = cipher.GeneratePswd();
    EXPECT_EQ(32u, first.length());
    EXPECT_TRUE(cipher.GenerateKeyIV(first));
    EXPECT_NE(Str(first), Str(second));
    VLString password = cipher.GeneratePswd();
    for (size_t length : {1, 7, 8, 15, 16, 17, 1000}) {
      std::string plain;
      for (size_t i = 0; i < length; ++i) plain += static_cast<char>('A' + i % 26);
      VLString encrypted = cipher.Encrypt(VLString(plain.c_str()), password);
      // PKCS#7 always adds padding: the next whole block, two characters a byte.
      EXPECT_EQ(2 * (length / c.block + 1) * c.block, encrypted.length()) << length;
      EXPECT_EQ(plain, Str(cipher.Decrypt(encrypted, password))) << length;
    }
    const char* utf8 = "Gr\xC3\xBC\xC3\x9F" "e \xE2\x82\xAC";
    EXPECT_EQ(utf8, Str(cipher.Decrypt(cipher.Encrypt(utf8, password), password)));
    // The plain text ends at its first 0 byte.
    EXPECT_EQ("ab", Str(cipher.Decrypt(cipher.Encrypt(VLString("ab\0cd", 5), password), password)));

    EXPECT_NE("secret", Str(cipher.Decrypt(cipher.Encrypt("secret", password), second)));
  }
}

TEST(EVPCipher, BadInputGivesEmptyText) {
  EVPCipher cipher(EVPCipher::AES_128_CBC);
  VLString encrypted = cipher.Encrypt("value", kPassword);
  ASSERT_EQ(32u, encrypted.length());

  // Empty, too short, too long, outside the alphabet, odd.
  for (const char* bad : {"", "0011223344556677", "00112233445566778899aabbccddeeff00",
                          "00112233445566778899aabbccddeefX", "00112233445566778899aabbccddeef"}) {
    EXPECT_FALSE(cipher.GenerateKeyIV(bad)) << bad;
  }

  EXPECT_TRUE(cipher.Encrypt("", kPassword).empty());
  EXPECT_TRUE(cipher.Encrypt("value", "").empty());
  EXPECT_TRUE(cipher.Encrypt("value", "not a password").empty());
  EXPECT_TRUE(cipher.Decrypt("", kPassword).empty());
  EXPECT_TRUE(cipher.Decrypt(encrypted, "").empty());
  EXPECT_TRUE(cipher.Decrypt(encrypted, "not a password").empty());
  EXPECT_TRUE(cipher.Decrypt(encrypted.substr(0, 31), kPassword).empty());  // odd length
  EXPECT_TRUE(cipher.Decrypt(encrypted.substr(0, 30), kPassword).empty());  // not whole blocks
  EXPECT_TRUE(cipher.Decrypt(encrypted.substr(0, 31) + "G", kPassword).empty());
  // The last block decides the padding: changing it breaks the padding check here.
  VLString damaged = encrypted;
  damaged[31] = damaged[31] == '0' ? '1' : '0';
  EXPECT_TRUE(cipher.Decrypt(damaged, kPassword).empty());
  EXPECT_EQ(0u, ERR_peek_error());  // nothing left for the next TLS call of this thread
  EXPECT_EQ("value", Str(cipher.Decrypt(encrypted, kPassword)));  // the context is reusable
}

}  // namespace
