// VLSimBoxArt: the image host's box-art pictures. Paths are "/images/boxart/<folder word>/
// <prefix><image word>.jpg" with the size words of the client's box-art sizes; the pictures are
// small real baseline JPEG files made on request, the same bytes for the same prefix, size and
// version, so that a client's cached copy can be compared byte for byte.
#ifndef VLSIMBOXART_H
#define VLSIMBOXART_H

#include <string>

// Splits a box-art path into the (percent-decoded) prefix and the size number 0 to 12; false
// when the path has not that form.
bool VLSimParseBoxArtPath(const std::string& path, std::string* prefix, int* size);

// The path of an image, the prefix percent-encoded (for tests and examples).
std::string VLSimBoxArtPath(const std::string& prefix, int size);

// The JPEG file of a box-art image: width from the size word, a colour from the prefix, and a
// comment segment naming prefix, size and version.
std::string VLSimBoxArtJpeg(const std::string& prefix, int size, int version);

#endif  // VLSIMBOXART_H
