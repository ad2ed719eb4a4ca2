#include "common/module_state.h"

namespace ardcard {

ModuleState& moduleState() {
    thread_local ModuleState state;
    return state;
}

QString companyDir(const ModuleState& state, int index) {
    if (index < 0 || index >= state.CompanyDirList.size())
        return {};
    return state.CompanyDirList.at(index);
}

} // namespace ardcard
