#include "VLTestRelay.h"

#include <arpa/inet.h>
#include <fcntl.h>
#include <netinet/in.h>
#include <poll.h>
#include <stdio.h>
#include <sys/socket.h>
#include <unistd.h>

#include <algorithm>
#include <random>
#include <vector>

namespace {

// The lowest port the system gives outgoing connections (32768 when it cannot be read), at least
// 11000, so that the relay has a thousand ports from 10000 up to choose from.
int EphemeralLow() {
  int low = 32768, high = 0;
  FILE* range = fopen("/proc/sys/net/ipv4/ip_local_port_range", "r");
  if (range) {
    if (fscanf(range, "%d %d", &low, &high) != 2) low = 32768;
    fclose(range);
  }
  return std::max(low, 11000);
}

sockaddr_in Loopback(int port) {
  sockaddr_in address = {};
  address.sin_family = AF_INET;
  address.sin_port = htons(static_cast<uint16_t>(port));
  address.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
  return address;
}

int ListenOn(int port) {
  int fd = socket(AF_INET, SOCK_STREAM | SOCK_CLOEXEC, 0);
  int one = 1;
  sockaddr_in address = Loopback(port);
  if (fd >= 0 && setsockopt(fd, SOL_SOCKET, SO_REUSEADDR, &one, sizeof one) == 0 &&
      bind(fd, reinterpret_cast<sockaddr*>(&address), sizeof address) == 0 && listen(fd, 64) == 0)
    return fd;
  if (fd >= 0) close(fd);
  return -1;
}

// One relayed connection: what each side has still to say.
struct Link {
  int fd[2];                    // the client's side, the target's side
  bool open[2] = {true, true};  // that side has not ended what it sends
};

// Closes both sides; with reset the peers see a reset, as the relay's own peer did.
void End(Link& link, bool reset) {
  for (int fd : link.fd) {
    if (reset) {
      linger hard = {1, 0};
      setsockopt(fd, SOL_SOCKET, SO_LINGER, &hard, sizeof hard);
    }
    close(fd);
  }
  link.open[0] = link.open[1] = false;
}

// Passes what side `from` sent on to the other side; its end, too.
void Pass(Link& link, int from) {
  char buffer[16384];
  ssize_t n = recv(link.fd[from], buffer, sizeof buffer, 0);
  if (n < 0) return End(link, true);
  if (n == 0) {
    link.open[from] = false;
    shutdown(link.fd[1 - from], SHUT_WR);
    if (!link.open[1 - from]) End(link, false);
    return;
  }
  for (ssize_t sent = 0; sent < n;) {
    ssize_t m = send(link.fd[1 - from], buffer + sent, static_cast<size_t>(n - sent), MSG_NOSIGNAL);
    if (m <= 0) return End(link, true);  // the peer is gone, or has read nothing for 5 s
    sent += m;
  }
}

// A link between a new client and the target; the sides' sends wait 5 s at most.
void Connect(std::vector<Link>* links, int client, int targetPort) {
  int target = socket(AF_INET, SOCK_STREAM | SOCK_CLOEXEC, 0);
  sockaddr_in address = Loopback(targetPort);
  if (target < 0 || connect(target, reinterpret_cast<sockaddr*>(&address), sizeof address) != 0) {
    if (target >= 0) close(target);
    close(client);
    return;
  }
  timeval wait = {5, 0};
  for (int fd : {client, target}) setsockopt(fd, SOL_SOCKET, SO_SNDTIMEO, &wait, sizeof wait);
  links->push_back({{client, target}});
}

}  // namespace

VLTestRelay::VLTestRelay(int targetPort) : m_Target(targetPort) {
  std::mt19937 random(std::random_device{}());
  int low = EphemeralLow();
  for (int attempt = 0; attempt < 100 && m_Listen < 0; ++attempt) {
    m_Port = 10000 + static_cast<int>(random() % static_cast<unsigned>(low - 10000));
    m_Listen = ListenOn(m_Port);
  }
  if (m_Listen < 0 || pipe2(m_Orders, O_CLOEXEC) != 0) {
    perror("VLTestRelay");
    abort();
  }
  m_Thread = std::thread(&VLTestRelay::Run, this);
}

VLTestRelay::~VLTestRelay() {
  Order('s');
  m_Thread.join();
  close(m_Orders[0]);
  close(m_Orders[1]);
}

bool VLTestRelay::SetRefusing(bool refusing) { return Order(refusing ? 'r' : 'l') == !refusing; }

bool VLTestRelay::Order(char order) {
  std::unique_lock<std::mutex> lock(m_Mutex);
  int carried = m_Carried + 1;
  if (write(m_Orders[1], &order, 1) != 1) {
    perror("VLTestRelay");
    abort();
  }
  m_Done.wait(lock, [&] { return m_Carried >= carried; });
  return m_Listening;
}

void VLTestRelay::Run() {
  std::vector<Link> links;
  for (bool stop = false; !stop;) {
    std::vector<pollfd> waits = {{m_Orders[0], POLLIN, 0}, {m_Listen, POLLIN, 0}};
    std::vector<std::pair<size_t, int>> sides;  // link and side of waits[2 + k]
    for (size_t k = 0; k < links.size(); ++k)
      for (int side = 0; side < 2; ++side)
        if (links[k].open[side]) {
          waits.push_back({links[k].fd[side], POLLIN, 0});
          sides.push_back({k, side});
        }
    if (poll(waits.data(), waits.size(), -1) < 0) continue;
    for (size_t k = 0; k < sides.size(); ++k) {
      Link& link = links[sides[k].first];  // which the other side's pass may have ended
      if (waits[2 + k].revents && link.open[sides[k].second]) Pass(link, sides[k].second);
    }
    links.erase(std::remove_if(links.begin(), links.end(), [](const Link& l) { return !l.open[0] && !l.open[1]; }),
                links.end());
    if (m_Listen >= 0 && (waits[1].revents & POLLIN)) {
      int client = accept4(m_Listen, nullptr, nullptr, SOCK_CLOEXEC);
      if (client >= 0) Connect(&links, client, m_Target);
    }
    char order;
    if (waits[0].revents && read(m_Orders[0], &order, 1) == 1) {
      if (m_Listen >= 0) close(m_Listen);
      m_Listen = order == 'l' ? ListenOn(m_Port) : -1;
      stop = order == 's';
      std::lock_guard<std::mutex> lock(m_Mutex);
      m_Listening = m_Listen >= 0;
      ++m_Carried;
      m_Done.notify_all();
    }
  }
  for (Link& link : links) End(link, false);
}
