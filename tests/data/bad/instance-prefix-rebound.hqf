<?xml version="1.0" encoding="UTF-8"?>
<Hqf:Hqf xmlns:Hqf="http://hqf.example/v2" xmlns:xsi="http://www.w3.org/2001/XMLSchema-instance">
	<Hqf:Preamble>
		<Hqf:Header>
			<Hqf:CustomAttribute>
				<Hqf:Name>Count</Hqf:Name>
				<Hqf:ValueChoice>
					<Hqf:IntegerValue>3</Hqf:IntegerValue>
				</Hqf:ValueChoice>
			</Hqf:CustomAttribute>
			<Hqf:Creator>Sample documents</Hqf:Creator>
			<Hqf:CreatorVersion>1.0</Hqf:CreatorVersion>
			<Hqf:ChangeHistory>2024-10-01T12:00:00Z</Hqf:ChangeHistory>
			<Hqf:Purpose>Test</Hqf:Purpose>
			<Hqf:ReadSDKInformation>
				<Hqf:SDKName>Hqf2-LMX-3.7.6</Hqf:SDKName>
				<Hqf:SDKVersion>1.0</Hqf:SDKVersion>
			</Hqf:ReadSDKInformation>
			<Hqf:WriteSDKInformation>
				<Hqf:SDKName>Hqf2-LMX-3.7.6</Hqf:SDKName>
				<Hqf:SDKVersion>1.0</Hqf:SDKVersion>
			</Hqf:WriteSDKInformation>
		</Hqf:Header>
		<Hqf:Owner>
			<Hqf:Person>
				<Hqf:Name>Nobody</Hqf:Name>
			</Hqf:Person>
		</Hqf:Owner>
	</Hqf:Preamble>
	<Hqf:Color ColorName="Leaf" ColorNumber="7">
		<Hqf:ChangeHistory>2024-10-01T12:00:00Z</Hqf:ChangeHistory>
		<Hqf:ColorSpaceSpectral>
			<Hqf:ChangeHistory>2024-10-01T12:00:00Z</Hqf:ChangeHistory>
			<Hqf:ColorSpaceSpecificationSpectrumSpectral>
				<Hqf:Profile Direction="Profile_Input">
					<Hqf:ProfileChoice>
						<Hqf:ProfileFile ProfileName="p.icc">AAECAwQF</Hqf:ProfileFile>
					</Hqf:ProfileChoice>
				</Hqf:Profile>
				<Hqf:Device>
					<Hqf:Manufacturer>Example Instruments</Hqf:Manufacturer>
					<Hqf:Model>Bench</Hqf:Model>
					<Hqf:SerialNumber>B-1</Hqf:SerialNumber>
					<Hqf:DeviceSettings>
						<Hqf:Averaging AveragingValue="3">true</Hqf:Averaging>
					</Hqf:DeviceSettings>
				</Hqf:Device>
				<Hqf:DeviceFilter>Filter_None</Hqf:DeviceFilter>
				<Hqf:DevicePolarization>false</Hqf:DevicePolarization>
				<Hqf:ChangeHistory>2024-10-01T12:00:00Z</Hqf:ChangeHistory>
				<Hqf:Spectrum>Spectrum_Reflectance</Hqf:Spectrum>
				<Hqf:GeometryChoice>
					<Hqf:Angle>45</Hqf:Angle>
				</Hqf:GeometryChoice>
			</Hqf:ColorSpaceSpecificationSpectrumSpectral>
			<Hqf:ReflectancePoint Wavelength="400">0.05</Hqf:ReflectancePoint>
			<Hqf:ReflectancePoint Wavelength="700">0.5</Hqf:ReflectancePoint>
		</Hqf:ColorSpaceSpectral>
		<Hqf:ColorSpaceCIELab>
			<Hqf:ChangeHistory>2024-10-01T12:00:00Z</Hqf:ChangeHistory>
			<Hqf:ColorSpaceSpecificationSpectrumTristimulus>
				<Hqf:DeviceFilter>Filter_None</Hqf:DeviceFilter>
				<Hqf:DevicePolarization>false</Hqf:DevicePolarization>
				<Hqf:ChangeHistory>2024-10-01T12:00:00Z</Hqf:ChangeHistory>
				<Hqf:Spectrum>Spectrum_Reflectance</Hqf:Spectrum>
				<Hqf:IlluminationOptions>
					<Hqf:Illuminant>Illuminant_D50</Hqf:Illuminant>
				</Hqf:IlluminationOptions>
				<Hqf:FieldOfView>FieldOfView_2_Degree</Hqf:FieldOfView>
			</Hqf:ColorSpaceSpecificationSpectrumTristimulus>
			<Hqf:L>52.25</Hqf:L>
			<Hqf:A>-38.5</Hqf:A>
			<Hqf:B>20.125</Hqf:B>
		</Hqf:ColorSpaceCIELab>
		<Hqf:ColorSpaceCIELCh>
			<Hqf:ChangeHistory>2024-10-01T12:00:00Z</Hqf:ChangeHistory>
			<Hqf:ColorSpaceSpecificationSpectrumTristimulus xsi:nil="true"/>
			<Hqf:L>52.25</Hqf:L>
			<Hqf:C>43.4</Hqf:C>
			<Hqf:H>152.4</Hqf:H>
		</Hqf:ColorSpaceCIELCh>
		<Hqf:ColorSpaceNCS xmlns:xsi="urn:other">
			<Hqf:ChangeHistory>2024-10-01T12:00:00Z</Hqf:ChangeHistory>
			<Hqf:ColorSpaceSpecificationSpectrumGeneric xsi:nil="true"/>
			<Hqf:ColorName>NCS S 3040-G</Hqf:ColorName>
		</Hqf:ColorSpaceNCS>
	</Hqf:Color>
	<Hqf:ColorQualityControl>
		<Hqf:ChangeHistory>2024-10-01T12:00:00Z</Hqf:ChangeHistory>
		<Hqf:StandardAndMeasurement>
			<Hqf:Standard xsi:nil="true"/>
		</Hqf:StandardAndMeasurement>
		<Hqf:PhysicalSample>
			<Hqf:SampleSpot>
				<Hqf:SubstratePaper>
				</Hqf:SubstratePaper>
				<Hqf:Specification>
					<Hqf:SampleWidth>5</Hqf:SampleWidth>
					<Hqf:SampleHeight>5</Hqf:SampleHeight>
				</Hqf:Specification>
			</Hqf:SampleSpot>
		</Hqf:PhysicalSample>
		<Hqf:Tolerance>
			<Hqf:FunctionDE94>
				<Hqf:Param_l>1</Hqf:Param_l>
				<Hqf:Param_c>1</Hqf:Param_c>
				<Hqf:Param_h>1</Hqf:Param_h>
			</Hqf:FunctionDE94>
			<Hqf:Limits>
				<Hqf:HighTolerance>2</Hqf:HighTolerance>
			</Hqf:Limits>
		</Hqf:Tolerance>
	</Hqf:ColorQualityControl>
</Hqf:Hqf>
