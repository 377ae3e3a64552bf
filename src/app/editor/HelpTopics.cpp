#include "HelpTopics.h"

#include <QStringList>

#include <algorithm>
#include <iterator>

namespace {

const HelpTopic kGeneral = {
    0, "Using the editor",
    "The tree on the left lists the sections of the setup. Select a section to edit it in "
    "the form on the right; every change is stored at once: a number when you leave its "
    "field, a check box, choice or drop-down list when you click it. A number that cannot be "
    "used is refused with a message naming the field, and the value stays as it was. "
    "Sections shown in grey are not used by the current setup; their values are kept and "
    "saved all the same.\n\n"
    "- Undo and redo: Edit > Undo (Ctrl+Z) and Redo (Ctrl+Shift+Z or Ctrl+Y) take back or "
    "repeat every stored change, also a change of the numbers of fractions or layers with "
    "all the items it added or removed.\n"
    "- Messages: the list below the form is checked again shortly after every change; "
    "double-click a message to go to its section, Copy (Ctrl+C) puts the selected messages "
    "on the clipboard with their keyword paths.\n"
    "- Validate (F7) checks the whole setup at once; saving validates as well.\n"
    "- Units: Edit > Preferences chooses the unit shown for each quantity. The file always "
    "holds the quantity's first unit.\n"
    "- Scrolling: the mouse wheel scrolls the form; it changes a drop-down list or a spin box "
    "only after you have clicked into it.\n\n"
    "The host data branch holds the flow model's own data that the module builds on: the "
    "modules in use, the domain with its boundaries, the simulation period, the hydrodynamic "
    "sources, density and wind forcing."};

// Sorted by id. Paragraphs are separated by blank lines; lines starting with "- " make a
// list, and a list line's text up to the first ": " is its name.
const HelpTopic kTopics[] = {
    {5001, "Mud Transport Module",
     "The mud-transport module describes cohesive sediment (mud) in the flow: its fractions in "
     "suspension, how they settle, deposit and are dispersed, and a bed of layers from which "
     "they erode.\n\n"
     "The module is used when \"Mud transport\" is ticked under Host data > Modules; "
     "otherwise its sections are kept but greyed and not validated.\n\n"
     "Start with the Parameter Selection, which fixes the numbers of fractions (1 to 8) and "
     "bed layers (1 to 12). Most other sections hold one item per fraction or per layer and "
     "follow these numbers at once."},
    {5002, "Wave database",
     "A wave database gives the wave conditions as a table of wave fields for combinations "
     "of wind speed, wind direction and water level. It can be chosen when the hydrodynamic "
     "wind forcing is included and varies in time."},
    {5003, "Waves",
     "Where the wave forcing comes from: no waves, a wave-field data file, a wave database, "
     "or the waves of a spectral-wave simulation run alongside (offered when that module is "
     "in use under Host data > Modules). With waves, the minimum water depth for including "
     "them, liquefaction and the bed shear stress formulation under waves and current apply."},
    {5004, "Initial Conditions",
     "The state at the start of the simulation: the suspended concentration of each "
     "fraction, the thickness of each bed layer and the share of each fraction in each "
     "layer."},
    {5006, "Initial fraction distribution",
     "For each bed layer, the share of each fraction in percent. The shares of a layer must "
     "add up to exactly 100; validation reports a layer that does not (\"The sum of fraction "
     "distributions in a layer must be 100\")."},
    {5007, "Initial concentrations",
     "The initial suspended concentration of each fraction (concentration, kg/m^3 in the "
     "file), each a constant or from a data file."},
    {5008, "Initial concentration of a fraction",
     "The initial suspended concentration of this fraction (kg/m^3 in the file), as a "
     "constant or from a data file."},
    {5009, "Initial layer thickness",
     "The initial thickness of each bed layer (m in the file), each a constant or from a data "
     "file."},
    {5010, "Initial thickness of a layer",
     "The initial thickness of this bed layer (m in the file), as a constant or from a data "
     "file."},
    {5011, "Bed Parameters",
     "The bed below the water column, as a stack of layers (their number is set under "
     "Parameter Selection). Its sections:\n\n"
     "- Erosion: the erosion law of each layer and the highest concentration that erosion may "
     "bring about.\n"
     "- Density of Bed Layer: the dry density of each layer.\n"
     "- Bed Roughness: the roughness of the bed for the bed shear stress.\n"
     "- Transition Between Layers: whether, and how fast, material passes from one layer into "
     "the next one below."},
    {5012, "Bed Roughness",
     "The roughness length of the bed used to compute the bed shear stress (roughness, m in "
     "the file; default 0.001 m).\n\n"
     "- Format: \"Constant\" uses the constant value everywhere; \"Varying in domain\" reads "
     "the roughness from a data file, with the item numbers to read.\n"
     "- Constant value: must be 0 or more; validation reports a negative constant "
     "(\"Constant value must be larger than or equal to 0.0\"), also when a data file is "
     "chosen."},
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
    {5017, "Density of a bed layer",
     "The dry density of this bed layer (density, kg/m^3 in the file), as a constant or "
     "varying in the domain from a data file. New layers take 180 (layer 1), 300 (layer 2), "
     "450 (layer 3) and 600 kg/m^3 (deeper layers)."},
    {5018, "Density of Bed Layer",
     "The dry density of every bed layer, one row per layer with its format and constant. "
     "Go to... opens a layer's own form, where the value or its data file is chosen."},
    {5019, "Viscosity and Density",
     "How the suspended mud feeds back on the flow. Offered when the hydrodynamic density "
     "varies (Host data > Density is not constant); otherwise the section is greyed and its "
     "values are kept.\n\n"
     "- Density Feedback on HD: the suspended sediment adds to the density of the water in "
     "the flow model. The three fields below are enabled only while this is ticked.\n"
     "- Density of Suspended Sediment: the density of the sediment grains (density, default "
     "2650 kg/m^3).\n"
     "- Base in Viscosity Formula: the base of the viscosity formula (no unit, default 1).\n"
     "- Concentration in Viscosity Formula: the concentration of the viscosity formula "
     "(concentration, default 1 kg/m^3).\n\n"
     "Any values are accepted; none is validated."},
    {5020, "Deposition of a fraction",
     "The critical bed shear stress for deposition of this fraction (bed shear stress, N/m^2 "
     "in the file; default 0.07): below it the fraction deposits. A constant, or varying in "
     "the domain from a data file."},
    {5022, "Dispersion",
     "Horizontal and vertical dispersion of the suspended fractions, each a list with one "
     "item per fraction. The vertical dispersion is used in three-dimensional models only "
     "(Host data > Domain > Three-dimensional); in a two-dimensional model it is greyed and "
     "kept."},
    {5023, "Dispersion of a fraction",
     "How the dispersion of this fraction is given.\n\n"
     "- Formulation: \"No dispersion\"; \"Dispersion coefficient formulation\", a coefficient "
     "of its own (dispersion coefficient, m^2/s in the file; default 0.01); or \"Scaled eddy "
     "viscosity formulation\", the flow's eddy viscosity times a factor (no unit; default "
     "1.0). Only the value of the chosen formulation is enabled; the other keeps its value.\n"
     "- Each value is a constant or from a data file; the scaled eddy viscosity may also vary "
     "over the vertical in a three-dimensional model."},
    {5024, "Dispersion of the fractions",
     "The formulation of every fraction's dispersion, one row per fraction. Go to... opens a "
     "fraction's own form."},
    {5026, "Erosion of a layer",
     "The erosion law of this bed layer.\n\n"
     "- Erosion description: \"Soft mud\" or \"Hard mud\". Switching it sets the power of "
     "erosion to the law's usual value: 8.3 for soft mud, 1.0 for hard mud.\n"
     "- Power of erosion: the exponent of the erosion law (no unit).\n"
     "- Erosion coefficient (kg/m^2/s in the file; default 0.00005) and critical shear stress "
     "for erosion (N/m^2; 0.1 for layer 1, 0.25 for layer 2, 0.4 below): stored with the "
     "layer.\n\n"
     "New layers take these defaults by their number: layer 1 soft mud, deeper layers hard "
     "mud."},
    {5027, "Erosion",
     "Erosion of the bed, one item per bed layer.\n\n"
     "- Maximum concentration allowed due to erosion: erosion stops adding sediment where the "
     "concentration reaches it (concentration, default 50 kg/m^3).\n"
     "- The grid shows each layer's mud type; Go to... opens the layer's own form."},
    {5028, "Forcings", "External forcings of the mud transport: waves."},
    {5029, "Morphology",
     "Whether the bed level follows erosion and deposition during the simulation.\n\n"
     "- Include Morphological calculations: the bed level is updated.\n"
     "- Apply speedup factor: the bed changes are multiplied by the factor, so that a short "
     "simulation stands for a longer period. Enabled only with the morphological "
     "calculations.\n"
     "- Speedup factor: a plain number (default 1.0), enabled only when both boxes are "
     "ticked. Any value is accepted.\n\n"
     "Values that are disabled are kept and saved."},
    {5030, "Output: map", "The geometry of the output on a map."},
    {5031, "Output items", "The quantities that the output writes."},
    {5032, "Output definition",
     "The result file of the output, its kind (2D, 3D, mass budget or discharge), its "
     "geometry (points, line, area or volume) and the time steps written."},
    {5033, "Outputs",
     "The result files the simulation writes. Add, remove and include outputs here; each "
     "output has its own settings and items."},
    {5034, "Sand Fractions",
     "Some of the suspended fractions may be sand rather than mud.\n\n"
     "- Include Sand Fractions: the grid below counts; while it is off the grid is greyed "
     "and every fraction is mud.\n"
     "- Include: this fraction is sand. A sand fraction takes no mud settling parameters: "
     "its row disappears from the Settling grids.\n"
     "- Mean Settling Velocity: the settling velocity of the sand fraction, in the unit "
     "chosen for settling velocities (m/s in the file; default 0.001 m/s). Enabled only for "
     "fractions marked as sand."},
    {5035, "Settling of a fraction",
     "The settling of this fraction. Which value is shown follows the Settling section:\n\n"
     "- With \"Use constant settling velocity\": the settling velocity (m/s in the file; "
     "default 0.0005).\n"
     "- With \"Include flocculation calculations\": the settling velocity coefficient of the "
     "flocculation formula (no unit; default 0.0005).\n\n"
     "Either is a constant or varies in the domain from a data file."},
    {5036, "Settling",
     "How the suspended mud fractions settle.\n\n"
     "- Flocculation: \"Include flocculation calculations\" makes the settling velocity grow "
     "with the concentration, from a coefficient per fraction; \"Use constant settling "
     "velocity\" gives each fraction a velocity of its own. The grid below shows the values "
     "of the chosen way.\n"
     "- Hindered settling: with flocculation, \"Include hindered settling calculations\" "
     "slows settling at high concentrations, by the Winterwerp or the Richardson and Zaki "
     "formulation.\n"
     "- Gelling Point: the concentration at which the mud forms a gel (concentration, default "
     "50 kg/m^3); used with hindered settling.\n"
     "- Density of sediment: the grain density (default 2650 kg/m^3).\n"
     "- Concentration for flocculation (default 0.01 kg/m^3) and Concentration for hindered "
     "settling (default 10 kg/m^3): where each process starts.\n\n"
     "Enabling: the hindered-settling box, the density and the two concentrations are enabled "
     "with flocculation only; the two formulations and the gelling point only when hindered "
     "settling is ticked as well. Fractions marked as sand (Sand Fractions) are not listed."},
    {5037, "Sources: map", "The point sources on a map."},
    {5038, "Sources: list", "The point sources of the flow model with their sediment."},
    {5039, "Source component",
     "The sediment that this source brings in for one fraction: a specified concentration "
     "or an excess over the ambient concentration, as a constant or from a data file."},
    {5040, "Source", "The sediment of every fraction that this source brings in."},
    {5041, "Sources", "All point sources of the flow model."},
    {5042, "Transition of a layer pair",
     "The rate at which material of this bed layer passes into the next one below "
     "(transition rate, 1/s in the file; default 0.001), as a constant or varying in the "
     "domain from a data file. Used only while \"Include\" is ticked under Transition Between "
     "Layers."},
    {5043, "Transition Between Layers",
     "Material may pass from each bed layer into the next one below, one item per pair of "
     "neighbouring layers (none with a single layer).\n\n"
     "- Include: the transitions are used. While it is off the grid is greyed and the items "
     "are not used, but their values are kept and saved.\n"
     "- The grid shows each pair's format and rate; Go to... opens the pair's own form."},
    {5044, "Water Column Parameters",
     "The suspended fractions in the water column:\n\n"
     "- Sand Fractions: which fractions are sand, with their settling velocity.\n"
     "- Settling: flocculation, hindered settling and the settling of each mud fraction.\n"
     "- Deposition: the concentration profile near the bed and the critical shear stress for "
     "deposition of each fraction.\n"
     "- Viscosity and Density: feedback of the sediment on the flow."},
    {5045, "Wave field", "A data file holding the wave field and the items that are read."},
    {5046, "Parameter Selection",
     "The two numbers that shape the whole module.\n\n"
     "- Number of Fractions: suspended sediment fractions, 1 to 8.\n"
     "- Number of Layers: bed layers, 1 to 12.\n\n"
     "A change takes effect as you type: every section that holds one item per fraction or "
     "per layer (settling, deposition, dispersion, sand fractions, erosion, bed density, "
     "transitions, initial and boundary conditions, sources, outputs) adds or removes items "
     "at once. Removed items lose their values; Edit > Undo brings them back. A number out "
     "of range is refused and the counts stay as they were."},
    {5047, "Solution technique",
     "The numerical schemes with which the transport equations are solved.\n\n"
     "- Time integration: \"Low order, fast algorithm\" or \"Higher order\" (the default).\n"
     "- Space discretization: the same choice for the horizontal scheme; the vertical scheme "
     "follows it."},
    {5048, "Dredging", "The dredgers of the setup. Add, remove and include dredgers here."},
    {5049, "Dredger",
     "Where a dredger takes and places material, how much, and how the dredged mass is "
     "split over the fractions."},
    {5051, "Deposition",
     "Deposition of the suspended fractions on the bed.\n\n"
     "- Apply Rouse Profile / Apply Teeter Profile: the vertical concentration profile used "
     "near the bed (Teeter by default).\n"
     "- Relative centroid height: the relative height of the profile's centroid (no unit, "
     "default 0.3); enabled with the Rouse profile only, kept otherwise.\n"
     "- Critical  Shear Stress for Deposition: one row per fraction, sand fractions "
     "included, with its format and constant; Go to... opens the fraction's own form."},
    {kHelpHostData, "Host data",
     "The flow model's own data that the mud-transport module builds on: the modules in use, "
     "the domain with its open boundaries, the simulation period, the hydrodynamic sources, "
     "density and wind forcing. These sections are stored in the same setup file; lists of "
     "the module that hold one item per boundary or per source follow every change made "
     "here."},
    {kHelpModules, "Modules",
     "Which modules the setup uses.\n\n"
     "- Mud transport: the module is used (mode 2). Unticked, its sections are kept and "
     "saved, shown in grey and not validated.\n"
     "- Spectral waves: a spectral-wave simulation runs alongside; the module's Waves section "
     "can then take the waves from it."},
    {kHelpDomain, "Domain",
     "The mesh of the model and its vertical layering.\n\n"
     "- Mesh file: the mesh; its extent (minimum and maximum X, Y and Z) and map projection "
     "describe it.\n"
     "- Three-dimensional: the model has vertical layers; this offers vertical dispersion "
     "and 3D outputs.\n"
     "- Layering: sigma layers, or sigma and z layers, with the number of each (0 to 1000); "
     "a three-dimensional model needs at least one layer."},
    {kHelpBoundaries, "Boundaries",
     "The open boundaries of the mesh, each with a name and its code in the mesh (codes must "
     "differ; 1 is the land boundary). Every list of the module that holds one item per "
     "boundary keeps its items with their boundaries: adding, inserting, deleting or moving a "
     "boundary here does the same there, and a rename renames them."},
    {kHelpPeriod, "Simulation Period",
     "The start of the simulation, the number of time steps and the time step interval (s). "
     "Outputs address time steps within this period."},
    {kHelpSources, "Hydrodynamic Sources",
     "The point sources of the flow model with their position (X, Y in the map projection "
     "of the domain). Every module that holds values per source keeps one item per source, "
     "in this order. Sources that are not included are kept but not used."},
    {kHelpDensity, "Density",
     "Whether the density of the water is constant (barotropic) or varies with salinity, "
     "temperature or both. Density feedback of the sediment (Viscosity and Density) is "
     "offered only when the density varies."},
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
QString ListLine(const QString& line) {
    const QString text = line.mid(2);
    const qsizetype colon = text.indexOf(QStringLiteral(": "));
    if (colon <= 0 || colon > 80)
        return QStringLiteral("<li>%1</li>").arg(text.toHtmlEscaped());
    return QStringLiteral("<li><b>%1</b>: %2</li>")
        .arg(text.left(colon).toHtmlEscaped(), text.mid(colon + 2).toHtmlEscaped());
}

QString Paragraphs(const HelpTopic& t) {
    QString html;
    for (const QString& para : QString::fromUtf8(t.text).split(QStringLiteral("\n\n"))) {
        if (!para.startsWith(QStringLiteral("- "))) {
            html += QStringLiteral("<p>%1</p>").arg(para.toHtmlEscaped());
            continue;
        }
        html += QStringLiteral("<ul>");
        for (const QString& line : para.split('\n'))
            html += ListLine(line);
        html += QStringLiteral("</ul>");
    }
    return html;
}
}  // namespace

QString HelpTopicBodyHtml(unsigned long id) {
    const HelpTopic* t = Lookup(id);
    return t ? Paragraphs(*t) : QString();
}

QString HelpTopicHtml(unsigned long id) {
    const HelpTopic& t = FindHelpTopic(id);
    // A section without a topic of its own gets the general help, without ado.
    return QStringLiteral("<h2>%1</h2>").arg(QString::fromUtf8(t.title).toHtmlEscaped()) + Paragraphs(t);
}
