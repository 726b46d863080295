// A movie of the application for tests: a stage on which the application, initialised with a
// launcher, has registered its classes.
#ifndef VLTESTMOVIE_H
#define VLTESTMOVIE_H

#include "VLStage.h"
#include "VeloraApp.h"

struct VLTestMovie {
  explicit VLTestMovie(int frameIntervalMs = 1) : stage(frameIntervalMs), launcher(&stage), app(createApplication2()) {
    app->init(&launcher);
  }
  // The stage closes first; the application then waits for the objects a movie dropped while
  // their requests ran.
  ~VLTestMovie() {
    stage.Close();
    delete app;
  }
  VLTestMovie(const VLTestMovie&) = delete;
  VLTestMovie& operator=(const VLTestMovie&) = delete;

  vlplatform::Stage stage;
  vlplatform::Launcher launcher;
  scLauncher::IApplication2* app;
};

#endif  // VLTESTMOVIE_H
