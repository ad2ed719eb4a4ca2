print("before");
throw new Error("נכשל בכוונה");
