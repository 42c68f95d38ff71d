#include "config/setup_ml_web_site.h"

#include "config/setup_mgr.h"
#include "config/system_ui.h"
#include "config/web_site_jump_interface.h"

namespace plugcore {

void SetupMLWebSite::on_select() {
  WebSiteJumpInterface* web = mgr_.use_web_site_jump();
  // A browser that cannot be started is reported to the debugger output only.
  if (web != nullptr) sys::open_url(web->get_url(code_));
}

}  // namespace plugcore
