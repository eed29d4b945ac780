-- commonTerms_fra: French texts of the keys in structured error
-- descriptions. Exactly the keys of commonTerms_eng, in the same sections
-- and order; a key missing here would be read from commonTerms_eng.
-- Terminology as in errors_fra.
--
-- Sections:
--   1. Usage types: the key shown before ": " and the value
--   2. DriverSetup and session-information messages (elaborations)
--   3. Other elaboration texts (the key is the English text)
--   4. Debug item keys

local entries = {
  -- 1. Usage types -------------------------------------------------------------
  kUsageTypeAffectedAttribute = "Attribut concerné",
  kUsageTypeAttributeId = "Attribut",
  kUsageTypeAttributeIdentifier = "Identificateur d'attribut",
  kUsageTypeConflictingAttr = "Attribut en conflit",
  kUsageTypeConflictingProperty = "Propriété en conflit",
  kUsageTypeDevice = "Périphérique",
  kUsageTypeFilePath = "Chemin du fichier",
  kUsageTypeInvalidIdentifier = "Identificateur non valide",
  kUsageTypeParameterName = "Nom du paramètre",
  kUsageTypeRequestedDeviceName = "Nom du périphérique demandé",
  kUsageTypeRequestedValue = "Valeur demandée",
  kUsageTypeUnspecifiedProperty = "Propriété non spécifiée",
  kSidlUsageTypeErrno = "Valeur de errno renvoyée par l'appel système.",

  -- 2. DriverSetup and session-information messages ---------------------------
  kSidlSetupContainsEqual = "La chaîne DriverSetup ne doit pas contenir de '='",
  kSidlSetupNotParsed = "La chaîne DriverSetup ne peut pas être analysée. Consultez la documentation pour " ..
    "connaître le format de la chaîne.",
  kSidlInvalidTag = "Balise DriverSetup non valide",
  kSidlRepeatedTag = "Balise DriverSetup répétée.",
  kSidlNotInteger = "La valeur DriverSetup n'est pas un entier.",
  kSidlNotBoolean = "La valeur DriverSetup n'est pas un booléen. Utilisez 0 ou 1.",
  kSidlNoTag = "Aucune balise DriverSetup n'est spécifiée. Vérifiez la chaîne DriverSetup.",
  kSidlNoValue = "DriverSetup contient une entrée sans valeur.",
  kSidlInvalidLanguage = "La langue spécifiée dans DriverSetup n'est pas valide.",
  kSidlInvalidResourceName = "Nom de ressource non valide.",
  kSidlRepeatedResourceName = "La chaîne DriverSetup contient des noms de ressource répétés. Chaque nom de " ..
    "ressource ne doit figurer qu'une seule fois dans DriverSetup.",
  kSidlNoResourceName = "Il manque le champ ResourceName dans la balise DriverSetup de la chaîne d'options. " ..
    "Consultez la documentation de la chaîne d'options pour connaître le format accepté.",
  kSidlInvalidFileHandle = "Descripteur de fichier non valide.",
  kSidlInitialization = "Les informations de session n'ont pas pu être initialisées.",
  kSidlMaxNumSessionsExceeded = "Le nombre maximal de sessions a été dépassé.",
  kSidlSharedMemMutex = "Le verrou des informations de session partagées n'a pas pu être acquis.",

  -- 3. Other elaboration texts --------------------------------------------------
  ["Oversized session information table data section"] =
    "Section de données de la table des informations de session trop volumineuse",
  ["You must set the CloseFunctionPtr prior to calling any functions."] =
    "Vous devez définir CloseFunctionPtr avant d'appeler une fonction.",
  ["Windows generated an error"] = "Le système d'exploitation a signalé une erreur",
  ["Windows Error Code:"] = "Code d'erreur système",
  ["Windows Error Message:"] = "Message d'erreur système",

  -- 4. Debug item keys ----------------------------------------------------------
  Component = "Composant",
  File = "Fichier",
  Line = "Ligne",
  ["Internal Error"] = "Erreur interne",
  -- The parts of a description the translator did not use, shown as JSON;
  -- the key is a name and stays the same in every language.
  rest_of_input_json = "rest_of_input_json",
}

return require("cvmxl_utilities").stringTable(entries)
