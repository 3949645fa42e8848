// Stamped executables made byte by byte, and a run without a screen.
#pragma once

#include <zlib.h>

#include <functional>
#include <memory>
#include <string>
#include <vector>

#include "installer/TestArchive.h"
#include "launcher/SfxStream.h"
#include "support/SourceScripts.h"
#include "support/TestFolder.h"
#include "wizard/HeadlessView.h"

inline std::string Compressed(const std::string& bytes) {
  uLongf nSize = compressBound(bytes.size());
  std::string packed(nSize, '\0');
  compress2(reinterpret_cast<Bytef*>(packed.data()), &nSize, reinterpret_cast<const Bytef*>(bytes.data()), bytes.size(),
            9);
  packed.resize(nSize);
  return packed;
}

// 100 bytes that stand for the program, with the stamp at 28, and the payload.
inline std::string Stamped(const std::string& payload, uint32_t payloadOffset = 100) {
  std::string program = "MZ" + std::string(98, '.');
  const std::string stamp = "rSFX" + std::string(12, '\0') + Number(payloadOffset) +
                            Number(static_cast<uint32_t>(payload.size())) + std::string(4, '\0');
  program.replace(28, stamp.size(), stamp);
  return program + payload;
}

// The carried scripts, and views that share one list of events.
class SetupFiles {
 public:
  SetupFiles() {
    LoadSourceScripts(scripts);
    surroundings.pScripts = &scripts;
    surroundings.pContext = this;
    surroundings.uEndPause = 0;
    surroundings.pMakeView = [](void* pFiles) { return static_cast<SetupFiles*>(pFiles)->pMakeView(); };
    CNString csTemp;
    bOsGetTempFolder(csTemp);
    tempFolder = csTemp.Text();
    m_before = TempFiles();
  }

  // The temporary files of the launcher's kind that were not there at the start.
  int NewTempFiles() const { return TempFiles() - m_before; }
  bool Saw(const std::string& part) const {
    for (const std::string& event : events)
      if (event.find(part) != std::string::npos) return true;
    return false;
  }

  TestFolder folder;
  CarriedScripts scripts;
  SetupSurroundings surroundings;
  std::string tempFolder;
  std::vector<std::string> events;
  std::function<bool(HeadlessView& view)> onIdle;  // of the installer's pages; the page that waits needs nobody

 private:
  std::unique_ptr<WizardView> pMakeView() {
    auto pView = std::make_unique<HeadlessView>();
    pView->onEvent = [this](const std::string& event) { events.push_back(event); };
    const bool bFirst = m_nViews++ == 0;
    if (bFirst && onIdle) pView->onIdle = onIdle;
    return pView;
  }
  static bool CountTemp(const OsFolderEntry& entry, void* pCount) {
    if (entry.csName.Text()[0] == '@') ++*static_cast<int*>(pCount);
    return true;
  }
  int TempFiles() const {
    int iCount = 0;
    bOsListFolder(tempFolder.c_str(), CountTemp, &iCount);
    return iCount;
  }

  int m_nViews = 0;
  int m_before = 0;
};
