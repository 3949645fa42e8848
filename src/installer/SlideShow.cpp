// The controls named in "commercial", shown one after the other by a worker while extraction runs.
#include "installer/CNInstallWizard.h"

// Before either worker starts, so that the first files are slowed down already.
void CNInstallWizard::PrepareSlides() {
  CNString csNames;
  csNames = szValue("commercial");
  m_Slides.RemoveAll();
  if (!csNames.bEmpty()) m_Slides.Set(csNames.Ptr(), ";", false);
  m_Extraction.iSlideCount = m_Slides.Size();
  m_Extraction.uMinimumTime = m_Extraction.uSlideInterval * static_cast<uint32_t>(m_Slides.Size());
  m_Extraction.bAllSlidesShown = m_bUnattended || m_Slides.Size() == 0;
}

void CNInstallWizard::ShowSlide(int iSlide, bool bVisible) {
  const BaseControl* pControl = *m_Slides[iSlide] ? GetBaseControl(m_Slides[iSlide]) : nullptr;
  if (pControl) m_View.bShow(*pControl, bVisible);
}

void CNInstallWizard::SlideShowThread() {
  const int iCount = m_Slides.Size();
  for (int iSlide = 0; iCount && m_Extraction.iBusy;) {
    SleepUnless(m_Extraction.uSlideInterval, [this] { return m_Extraction.iBusy == 0; });
    if (!m_Extraction.iBusy) return;
    ShowSlide(iSlide, false);
    if (++iSlide == iCount) {
      m_Extraction.bAllSlidesShown = 1;
      iSlide = 0;
    }
    ShowSlide(iSlide, true);
  }
}
