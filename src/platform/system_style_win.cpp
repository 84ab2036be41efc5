#include "platform/system_style_win.h"

namespace {

// The manifest that asks for common controls 6, beside the program's own (1).
constexpr WORD kSystemStyleManifest = 2;

// Made once, at the first box, and kept while the program runs.
HANDLE StyleContext(HINSTANCE module) {
    static HANDLE context = [module] {
        wchar_t path[MAX_PATH];
        DWORD length = GetModuleFileNameW(module, path, MAX_PATH);
        if (length == 0 || length >= MAX_PATH) return INVALID_HANDLE_VALUE;
        ACTCTXW request{};
        request.cbSize = sizeof(request);
        request.dwFlags = ACTCTX_FLAG_HMODULE_VALID | ACTCTX_FLAG_RESOURCE_NAME_VALID;
        request.lpSource = path;
        request.hModule = module;
        request.lpResourceName = MAKEINTRESOURCEW(kSystemStyleManifest);
        return CreateActCtxW(&request);
    }();
    return context;
}

}  // namespace

SystemStyle::SystemStyle(HINSTANCE module) {
    HANDLE context = StyleContext(module);
    if (context != INVALID_HANDLE_VALUE) active_ = ActivateActCtx(context, &cookie_) != FALSE;
}

SystemStyle::~SystemStyle() {
    if (active_) DeactivateActCtx(0, cookie_);
}
