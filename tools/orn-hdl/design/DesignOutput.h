// The netlists of a design of several models.
#pragma once

#include "Output.h"

#include <string>
#include <vector>

namespace Tool {

/// A model of a design, and how it is written.
struct DesignModel {
    Orn_Hdl::Model* model = nullptr;
    /// Writes the model legally; null to write it as it stands.
    Orn_Hdl::LegalNetlist* legal = nullptr;
    /// Reports what the proof finds that the model's options ask for.
    TellDifferences tell;
};

/// Writes the netlists of all models: each language into one file with one header, or each model
/// into a file of its own if the outputs have a folder.
/// \param models in the order of compilation.
/// \param certificate gets what was proven, each model of a file on its own.
Status WriteDesign(const std::vector<DesignModel>& models, const Outputs& outputs,
                   Progress& progress, Certificate& certificate);

/// The files of models in a folder, with the names of the models as far as files can have them.
/// \param extension with its period.
std::vector<std::string> MakeFileNames(const std::vector<std::string>& models,
                                       const std::string& folder, const std::string& extension);

/// Makes a folder unless there is one. Prints a message if that fails.
Status MakeFolder(const std::string& folder);

/// Writes a list of files, one a line. \param name the file of the list; "-" is standard output.
Status WriteFileList(const std::string& name, const std::vector<std::string>& files);

} // namespace Tool
