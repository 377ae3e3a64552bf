#include "HelpTopics.h"

#include <QStringList>

#include <algorithm>
#include <iterator>

namespace {

const HelpTopic kGeneral = {
    0, "Using the editor",
    "The tree on the left lists the sections of the setup. Select a section to edit it in "
    "the form on the right; every change is stored at once. Sections shown in grey are not "
    "used by the current setup.\n\n"
    "Validate (F7) checks the whole setup and lists the problems below the form; double-click "
    "a message to go to its section. Saving validates as well.\n\n"
    "The host data branch holds the flow model's own data that the module builds on: the "
    "domain with its boundaries, the simulation period, the hydrodynamic sources, density "
    "and wind forcing. Units of the values shown are chosen under Edit > Preferences."};

// Sorted by id.
const HelpTopic kTopics[] = {
    {5001, "Mud Transport Module",
     "The mud-transport module simulates the transport of cohesive sediment: erosion, "
     "transport in suspension, settling and deposition of several fractions, and the "
     "evolution of a layered bed.\n\n"
     "The module is used when it is switched on under Host data > Modules. Start with the "
     "model definition, which fixes the numbers of fractions and bed layers; most other "
     "sections hold one item per fraction or per layer."},
    {5002, "Wave database",
     "A wave database gives the wave conditions as a table of wave fields for combinations "
     "of wind speed, wind direction and water level. It is available when the hydrodynamic "
     "wind forcing is included and varies in time."},
    {5003, "Waves",
     "Choose where the wave forcing comes from: no waves, a wave-field data file, a wave "
     "database, or the wave field of a spectral-wave simulation run alongside. With waves, "
     "set the minimum water depth for including them, liquefaction, and the formulation of "
     "the bed shear stress under combined waves and current."},
    {5004, "Initial Conditions",
     "The initial state of the model: the suspended concentration of each fraction, the "
     "thickness of each bed layer and the distribution of the fractions within each layer."},
    {5006, "Initial fraction distribution",
     "For each bed layer, the share of each fraction in percent. The shares of a layer must "
     "add up to 100."},
    {5007, "Initial concentrations",
     "The initial suspended concentration of each fraction, as a constant or from a data "
     "file."},
    {5008, "Initial concentration of a fraction",
     "The initial suspended concentration of this fraction, as a constant or from a data "
     "file."},
    {5009, "Initial layer thickness",
     "The initial thickness of each bed layer, as a constant or from a data file."},
    {5010, "Initial thickness of a layer",
     "The initial thickness of this bed layer, as a constant or from a data file."},
    {5011, "Bed Parameters",
     "The properties of the bed layers: erosion, density, roughness and the transition of "
     "material between neighbouring layers."},
    {5012, "Bed Roughness",
     "The bed roughness used for the bed shear stress, as a constant or from a data file."},
    {5013, "Boundary conditions: map",
     "The open boundaries of the mesh on a map. Use the context menu to go to the boundary "
     "values of a boundary."},
    {5014, "Boundary",
     "One open boundary of the mesh. Its values are given per fraction in the items below "
     "it."},
    {5015, "Boundary value",
     "The suspended concentration of one fraction at this boundary: land, specified values "
     "(constant or from a data file) or a zero gradient, with optional soft start and the "
     "interpolation in time and space."},
    {5016, "Boundary conditions: list",
     "All boundaries with the type of each fraction's boundary value. Go to... opens the "
     "value of a fraction at a boundary."},
    {5017, "Density of a bed layer", "The dry density of this bed layer."},
    {5018, "Density of bed layers", "The dry density of each bed layer."},
    {5019, "Viscosity and Density",
     "How suspended sediment feeds back on the flow through the density and the viscosity of "
     "the water. Used when the hydrodynamic density varies."},
    {5020, "Deposition of a fraction",
     "The critical bed shear stress below which this fraction deposits."},
    {5022, "Dispersion",
     "Horizontal and vertical dispersion of the suspended fractions. The vertical dispersion "
     "is used in three-dimensional models only."},
    {5023, "Dispersion of a fraction",
     "How the dispersion coefficient of this fraction is given: scaled from the eddy "
     "viscosity or as a value of its own."},
    {5024, "Dispersion of the fractions", "The dispersion settings of every fraction."},
    {5026, "Erosion of a layer",
     "The erosion law of this bed layer with its critical shear stress, erosion coefficient "
     "and power."},
    {5027, "Erosion", "The erosion law of every bed layer."},
    {5028, "Forcings", "External forcings of the mud transport: waves."},
    {5029, "Morphology",
     "Whether and how the bed level follows erosion and deposition during the simulation."},
    {5030, "Output: map", "The geometry of the output on a map."},
    {5031, "Output items", "The quantities that the output writes."},
    {5032, "Output definition",
     "The result file of the output, its kind (2D, 3D, mass budget or discharge), its "
     "geometry (points, line, area or volume) and the time steps written."},
    {5033, "Outputs",
     "The result files the simulation writes. Add, remove and include outputs here; each "
     "output has its own settings and items."},
    {5034, "Sand Fractions",
     "Mark fractions as sand and give their mean settling velocity."},
    {5035, "Settling of a fraction",
     "The settling velocity of this fraction, or the coefficient of the flocculation "
     "formula."},
    {5036, "Settling",
     "How settling is described: a constant velocity, flocculation and hindered settling, "
     "with the settling settings of every fraction."},
    {5037, "Sources: map", "The point sources on a map."},
    {5038, "Sources: list", "The point sources of the flow model with their sediment."},
    {5039, "Source component",
     "The sediment that this source brings in for one fraction: a specified concentration "
     "or an excess over the ambient concentration, as a constant or from a data file."},
    {5040, "Source", "The sediment of every fraction that this source brings in."},
    {5041, "Sources", "All point sources of the flow model."},
    {5042, "Transition of a layer pair",
     "The rate at which material passes from this bed layer into the next one below."},
    {5043, "Transition Between Layers",
     "The transition of material between every pair of neighbouring bed layers."},
    {5044, "Water Column Parameters",
     "The properties of the suspended fractions: sand fractions, settling, deposition, and "
     "density and viscosity feedback."},
    {5045, "Wave field", "A data file holding the wave field and the items that are read."},
    {5046, "Model definition",
     "The number of suspended sediment fractions (1 to 8) and the number of bed layers "
     "(1 to 12).\n\n"
     "Changing a number adds or removes the items of every section that holds one item per "
     "fraction or per layer at once: settling, deposition, dispersion, erosion, bed density, "
     "initial and boundary conditions, sources and outputs. Removed items lose their "
     "values."},
    {5047, "Solution technique",
     "The numerical schemes of the transport equations: time integration and space "
     "discretization, each either low order (fast) or higher order. The vertical scheme "
     "follows the horizontal one."},
    {5048, "Dredging", "The dredgers of the setup. Add, remove and include dredgers here."},
    {5049, "Dredger",
     "Where a dredger takes and places material, how much, and how the dredged mass is "
     "split over the fractions."},
    {5051, "Deposition",
     "The critical bed shear stress for deposition of every fraction and the deposition "
     "profile."},
    {kHelpHostData, "Host data",
     "The flow model's own data that the mud-transport module builds on. These sections are "
     "stored in the same setup file."},
    {kHelpModules, "Modules",
     "Which modules the setup uses. The mud-transport module is used when it is switched "
     "on here; otherwise its sections are kept but shown in grey and not validated."},
    {kHelpDomain, "Domain",
     "The mesh of the model: its file, extent and map projection, and whether the model is "
     "three-dimensional with sigma (and z) layers. Three-dimensional models offer vertical "
     "dispersion and 3D outputs."},
    {kHelpBoundaries, "Boundaries",
     "The open boundaries of the mesh, each with a name and its code in the mesh. Every "
     "module that holds boundary values keeps one item per boundary, in this order: adding, "
     "removing or moving a boundary here does the same there."},
    {kHelpPeriod, "Simulation Period",
     "The start of the simulation, the number of time steps and the time step interval. "
     "Outputs address time steps within this period."},
    {kHelpSources, "Hydrodynamic Sources",
     "The point sources of the flow model with their position. Every module that holds "
     "values per source keeps one item per source, in this order. Sources that are not "
     "included are kept but not used."},
    {kHelpDensity, "Density",
     "Whether the density of the water is constant (barotropic) or varies with salinity, "
     "temperature or both. Density feedback of the sediment is offered only when the "
     "density varies."},
    {kHelpWind, "Wind Forcing",
     "Whether the flow model is forced by wind and how the wind is given. A wave database "
     "needs wind that varies in time."},
};

const HelpTopic* Lookup(unsigned long id) {
    auto it = std::lower_bound(std::begin(kTopics), std::end(kTopics), id,
                               [](const HelpTopic& t, unsigned long v) { return t.id < v; });
    return it != std::end(kTopics) && it->id == id ? it : nullptr;
}

}  // namespace

const HelpTopic& FindHelpTopic(unsigned long id) {
    const HelpTopic* t = Lookup(id);
    return t ? *t : kGeneral;
}

bool HasHelpTopic(unsigned long id) { return Lookup(id) != nullptr; }

namespace {
QString Paragraphs(const HelpTopic& t) {
    QString html;
    for (const QString& para : QString::fromUtf8(t.text).split(QStringLiteral("\n\n")))
        html += QStringLiteral("<p>%1</p>").arg(para.toHtmlEscaped());
    return html;
}
}  // namespace

QString HelpTopicBodyHtml(unsigned long id) {
    const HelpTopic* t = Lookup(id);
    return t ? Paragraphs(*t) : QString();
}

QString HelpTopicHtml(unsigned long id) {
    const HelpTopic& t = FindHelpTopic(id);
    QString html = QStringLiteral("<h2>%1</h2>").arg(QString::fromUtf8(t.title).toHtmlEscaped());
    if (id != 0 && !HasHelpTopic(id))
        html += QStringLiteral("<p><i>There is no help topic %1; this is the general help.</i></p>")
                    .arg(id);
    html += Paragraphs(t);
    if (t.id != 0)
        html += QStringLiteral("<p style='color:gray'>Help topic %1</p>").arg(t.id);
    return html;
}
