// Intentionally empty: libConfiguration.so is ConfigurationCore linked whole.
