// VLJsonWriter: writes JSON text for the command-line client, two blanks of indentation per
// level, one member or element per line, so that a person can read a store's answer and a script
// can parse it.
//
//   VLJsonWriter json;
//   json.BeginObject();
//   json.Key("TitleID"); json.Int(1001);
//   json.Key("Genres"); json.BeginArray(); json.Int(3); json.EndArray();
//   json.EndObject();
//   fputs(json.Text().c_str(), stdout);
//
// Texts are written as the bytes they hold (the store's texts are UTF-8); quotes, backslashes
// and control characters are escaped.
#ifndef VLJSONWRITER_H
#define VLJSONWRITER_H

#include <stddef.h>

#include <string>

class VLJsonWriter {
 public:
  void BeginObject() { Begin('{'); }
  void EndObject() { End('}'); }
  void BeginArray() { Begin('['); }
  void EndArray() { End(']'); }
  // The name of the next member of the open object.
  void Key(const char* name);

  void Int(long long value);
  void Bool(bool value);
  // A null text is written as null: only a record that a call refused or failed holds one.
  void String(const char* text);
  void String(const char* bytes, size_t length);

  // Everything written so far, with a final line end once the outermost value is closed.
  const std::string& Text() const { return m_Out; }

 private:
  void Begin(char bracket);
  void End(char bracket);
  // Starts a value: a separator and a new line inside an array, nothing after a key.
  void StartValue();
  void NewLine();
  void Quote(const char* bytes, size_t length);

  std::string m_Out;
  int m_Depth = 0;
  bool m_Empty = true;      // the open object or array has no member yet
  bool m_AfterKey = false;  // a key was written and waits for its value
};

#endif  // VLJSONWRITER_H
