// VLTestRelay: a loopback TCP relay in front of another loopback port, so that a test can make a
// server's port refuse connections for a while and then serve again on the same port (a client
// reads VLWS_CONNECT_TO once, so the port it is sent to cannot change).
#ifndef VLTESTRELAY_H
#define VLTESTRELAY_H

#include <condition_variable>
#include <mutex>
#include <thread>

class VLTestRelay {
 public:
  // Listens on a free port of 127.0.0.1 below the ephemeral range (so that no outgoing
  // connection takes it while the relay refuses) and passes each connection on to 127.0.0.1:
  // targetPort, byte for byte both ways; an end or reset on one side ends the other.
  explicit VLTestRelay(int targetPort);
  ~VLTestRelay();  // ends every connection and the relay's thread
  VLTestRelay(const VLTestRelay&) = delete;
  VLTestRelay& operator=(const VLTestRelay&) = delete;

  int Port() const { return m_Port; }
  // While refusing, nobody listens on Port(): a connection attempt is refused at once.
  // Connections already relayed go on. False when the port cannot be listened on again.
  bool SetRefusing(bool refusing);

 private:
  // Hands the relay's thread one order ('r' refuse, 'l' listen, 's' stop) and waits until it
  // was carried out (the thread alone touches the sockets). Whether the relay listens now.
  bool Order(char order);
  void Run();

  const int m_Target;
  int m_Port = 0;
  int m_Listen = -1;           // the listening socket, -1 while refusing; the thread's
  int m_Orders[2] = {-1, -1};  // a pipe to the thread
  std::mutex m_Mutex;
  std::condition_variable m_Done;
  int m_Carried = 0;        // orders carried out, under m_Mutex
  bool m_Listening = true;  // under m_Mutex
  std::thread m_Thread;
};

#endif  // VLTESTRELAY_H
