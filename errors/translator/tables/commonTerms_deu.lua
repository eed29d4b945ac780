-- commonTerms_deu: German texts of the keys in structured error
-- descriptions. Exactly the keys of commonTerms_eng, in the same sections
-- and order; a key missing here would be read from commonTerms_eng.
-- Terminology as in errors_deu.
--
-- Sections:
--   1. Usage types: the key shown before ": " and the value
--   2. DriverSetup and session-information messages (elaborations)
--   3. Other elaboration texts (the key is the English text)
--   4. Debug item keys

local entries = {
  -- 1. Usage types -------------------------------------------------------------
  kUsageTypeAffectedAttribute = "Betroffenes Attribut",
  kUsageTypeAttributeId = "Attribut",
  kUsageTypeAttributeIdentifier = "Attributbezeichner",
  kUsageTypeConflictingAttr = "In Konflikt stehendes Attribut",
  kUsageTypeConflictingProperty = "In Konflikt stehende Eigenschaft",
  kUsageTypeDevice = "Gerät",
  kUsageTypeFilePath = "Dateipfad",
  kUsageTypeInvalidIdentifier = "Ungültiger Bezeichner",
  kUsageTypeParameterName = "Parametername",
  kUsageTypeRequestedDeviceName = "Angeforderter Gerätename",
  kUsageTypeRequestedValue = "Angeforderter Wert",
  kUsageTypeUnspecifiedProperty = "Nicht angegebene Eigenschaft",
  kSidlUsageTypeErrno = "Wert von errno aus dem Systemaufruf.",

  -- 2. DriverSetup and session-information messages ---------------------------
  kSidlSetupContainsEqual = "Der DriverSetup-String darf kein '=' enthalten",
  kSidlSetupNotParsed = "Der DriverSetup-String kann nicht ausgewertet werden. Das Format des Strings ist " ..
    "in der Dokumentation beschrieben.",
  kSidlInvalidTag = "Ungültiges DriverSetup-Tag",
  kSidlRepeatedTag = "Wiederholtes DriverSetup-Tag.",
  kSidlNotInteger = "Der DriverSetup-Wert ist keine Ganzzahl.",
  kSidlNotBoolean = "Der DriverSetup-Wert ist kein boolescher Wert. Verwenden Sie 0 oder 1.",
  kSidlNoTag = "Es ist kein DriverSetup-Tag angegeben. Prüfen Sie den DriverSetup-String.",
  kSidlNoValue = "DriverSetup enthält einen Eintrag ohne Wert.",
  kSidlInvalidLanguage = "Die in DriverSetup angegebene Sprache ist ungültig.",
  kSidlInvalidResourceName = "Ungültiger Ressourcenname.",
  kSidlRepeatedResourceName = "Der DriverSetup-String enthält wiederholte Ressourcennamen. Geben Sie jeden " ..
    "Ressourcennamen in DriverSetup nur einmal an.",
  kSidlNoResourceName = "Im DriverSetup-Tag des Optionsstrings fehlt das Feld ResourceName. Das zulässige " ..
    "Format ist in der Dokumentation des Optionsstrings beschrieben.",
  kSidlInvalidFileHandle = "Ungültiges Datei-Handle.",
  kSidlInitialization = "Die Sitzungsinformationen konnten nicht initialisiert werden.",
  kSidlMaxNumSessionsExceeded = "Die maximale Anzahl von Sitzungen wurde überschritten.",
  kSidlSharedMemMutex = "Die Sperre der gemeinsam genutzten Sitzungsinformationen konnte nicht belegt werden.",

  -- 3. Other elaboration texts --------------------------------------------------
  ["Oversized session information table data section"] =
    "Übergroßer Datenabschnitt der Tabelle der Sitzungsinformationen",
  ["You must set the CloseFunctionPtr prior to calling any functions."] =
    "CloseFunctionPtr muss gesetzt werden, bevor eine Funktion aufgerufen wird.",
  ["Windows generated an error"] = "Das Betriebssystem hat einen Fehler gemeldet",
  ["Windows Error Code:"] = "Systemfehlercode",
  ["Windows Error Message:"] = "Systemfehlermeldung",

  -- 4. Debug item keys ----------------------------------------------------------
  Component = "Komponente",
  File = "Datei",
  Line = "Zeile",
  ["Internal Error"] = "Interner Fehler",
  -- The parts of a description the translator did not use, shown as JSON;
  -- the key is a name and stays the same in every language.
  rest_of_input_json = "rest_of_input_json",
}

return require("cvmxl_utilities").stringTable(entries)
