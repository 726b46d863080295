// ae::stagecraft::StageWindow: the window the engine plays the movie in. Extension methods
// receive it with every call.
#ifndef STAGEWINDOW_H
#define STAGEWINDOW_H

namespace ae {
namespace stagecraft {

class StageWindow {
 public:
  // Asks the movie to quit: the engine ends its frame loop once the running script code and the
  // current frame are done.
  virtual void Quit() = 0;

 protected:
  virtual ~StageWindow() {}
};

}  // namespace stagecraft
}  // namespace ae

#endif  // STAGEWINDOW_H
