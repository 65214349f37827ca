#include "C/Calls.h"

#include "C/Texts.h"
#include "Orn_Hdl/Exception.h"
#include "Orn_Hdl/Proof.h"

#include <new>

namespace Orn_Hdl::CInterface {

namespace {

orn_hdl_status_t Remember(LastError* error, orn_hdl_status_t status,
                          std::string_view text) noexcept {
    if (error != nullptr) {
        error->Set(status, text.empty() ? orn_hdl_status_text(status) : text);
    }
    return status;
}

} // namespace

orn_hdl_status_t StatusOfException(LastError* error) noexcept {
    try {
        throw;
    } catch (const CallFailure& failure) {
        return Remember(error, failure.status, failure.text);
    } catch (const ProofException& exception) {
        return Remember(error, ORN_HDL_DIFFERS, exception.getLocalized().GetView());
    } catch (const Exception& exception) {
        return Remember(error, ORN_HDL_FAILED, exception.getLocalized().GetView());
    } catch (const std::bad_alloc&) {
        return Remember(error, ORN_HDL_NO_MEMORY, {});
    } catch (const std::exception& exception) {
        return Remember(error, ORN_HDL_UNEXPECTED, exception.what());
    } catch (...) {
        return Remember(error, ORN_HDL_UNEXPECTED, {});
    }
}

Language ToLanguage(orn_hdl_language_t language) {
    Require(language == ORN_HDL_VERILOG || language == ORN_HDL_VHDL);
    return language == ORN_HDL_VERILOG ? Language::Verilog : Language::Vhdl;
}

orn_hdl_status_t TellError(const LastError& error, orn_hdl_error_t* result) {
    return Attempt(nullptr, [&] {
        Require(result != nullptr);
        Texts texts;
        texts.Put(result->text, error.text);
        texts.Put(result->file, error.file);
        texts.HandOut();
        result->status = error.status;
        result->line = error.line;
    });
}

} // namespace Orn_Hdl::CInterface
