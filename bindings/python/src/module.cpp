#include <pybind11/pybind11.h>
#include <voreleffect/VFVersion.h>

#include <cstring>
#include <exception>
#include <string>

#include "compose/error.h"
#include "native_look.h"
#include "native_style.h"
#include "painting.h"
#include "style/vorelstyle.h"
#include "text/voreltext.h"
#include "texts.h"

namespace {

namespace py = pybind11;

/// A new exception of the package, under the name that Python's own machinery finds it by.
py::object exceptionOf(py::module_& module, const char* name, const py::handle& base, const char* doc) {
    const std::string full = std::string("voreleffect.") + name;
    auto made = py::reinterpret_steal<py::object>(
        PyErr_NewExceptionWithDoc(full.c_str(), doc, base.ptr(), nullptr));
    if (!made) throw py::error_already_set();
    module.add_object(name, made);
    return made;
}

/// They live as long as the process does.
PyObject* styleError = nullptr;
PyObject* textError = nullptr;

/// Messages may quote the bytes of files.
void setError(PyObject* type, const char* what) {
    PyObject* const text =
        PyUnicode_DecodeUTF8(what, static_cast<Py_ssize_t>(std::strlen(what)), "replace");
    if (text == nullptr) return;
    PyErr_SetObject(type, text);
    Py_DECREF(text);
}

/// What pybind11 calls it with is a copy.
void translate(std::exception_ptr thrown) {  // NOLINT(performance-unnecessary-value-param)
    try {
        if (thrown) std::rethrow_exception(thrown);
    } catch (const vorelstyle::StyleError& error) {
        setError(styleError, error.what());
    } catch (const voreltext::TextError& error) {
        setError(textError, error.what());
    } catch (const vorelcompose::ComposeError& error) {
        setError(textError, error.what());
    }
}

}  // namespace

PYBIND11_MODULE(_voreleffect, module) {
    module.attr("version") = VOREL_VERSION_STRING;
    const py::object error = exceptionOf(module, "Error", PyExc_ValueError,
                                         "What voreleffect refuses: the base of both others.");
    styleError = exceptionOf(module, "StyleError", error, "What is wrong with a style, and where.")
                     .release()
                     .ptr();
    textError = exceptionOf(module, "TextError", error,
                            "A text, a font or a picture of a text that cannot be had, and why.")
                    .release()
                    .ptr();
    py::register_exception_translator(translate);
    vorelpython::defineLooks(module);
    vorelpython::definePainting(module);
    vorelpython::defineStyles(module);
    vorelpython::defineTexts(module);
}
