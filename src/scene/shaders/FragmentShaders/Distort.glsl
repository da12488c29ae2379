// A picture as a camera's lens shows it: radial distortion of three terms, on the sensor.
uniform sampler2D t_Texture;
uniform vec2 u_RadialDistortionCentre;
uniform vec3 u_RadialDistortionParameters;
uniform vec2 u_SensorSize;

varying vec2 v_UV;

void main()
{
	vec2 offset = v_UV * u_SensorSize - u_RadialDistortionCentre;
	float square = dot(offset, offset) / dot(u_SensorSize, u_SensorSize);
	vec3 k = u_RadialDistortionParameters;
	float scale = 1.0 + square * (k.x + square * (k.y + square * k.z));
	gl_FragColor = texture2D(t_Texture, (u_RadialDistortionCentre + offset * scale) / u_SensorSize);
}
